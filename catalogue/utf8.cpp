#include "catalogue/utf8.h"

#include <cstdint>
#include <cstring>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

namespace catalogue {

std::string latin1ToUtf8(std::string_view latin1) {
    std::string utf8;
    utf8.reserve(latin1.size() + latin1.size() / 8);
    for (char c : latin1) {
        const auto byte = static_cast<unsigned char>(c);
        if (byte < 0x80) {
            utf8.push_back(c);
        } else {
            utf8.push_back(static_cast<char>(0xC0 | (byte >> 6)));
            utf8.push_back(static_cast<char>(0x80 | (byte & 0x3F)));
        }
    }
    return utf8;
}

namespace {

// Decodes the character at `at`; nothing when the bytes there are no well-formed UTF-8.
std::optional<char32_t> decodeOne(std::string_view bytes, std::size_t& at) {
    const auto lead = static_cast<unsigned char>(bytes[at]);
    int length = 0;
    char32_t code = 0;
    if (lead < 0x80) {
        ++at;
        return lead;
    } else if (lead >= 0xC2 && lead <= 0xDF) {
        length = 2;
        code = lead & 0x1F;
    } else if (lead >= 0xE0 && lead <= 0xEF) {
        length = 3;
        code = lead & 0x0F;
    } else if (lead >= 0xF0 && lead <= 0xF4) {
        length = 4;
        code = lead & 0x07;
    } else {
        return std::nullopt;
    }
    if (at + static_cast<std::size_t>(length) > bytes.size()) return std::nullopt;
    for (int i = 1; i < length; ++i) {
        const auto next = static_cast<unsigned char>(bytes[at + static_cast<std::size_t>(i)]);
        if ((next & 0xC0) != 0x80) return std::nullopt;
        code = (code << 6) | (next & 0x3F);
    }
    const char32_t smallest = length == 3 ? 0x800 : length == 4 ? 0x10000 : 0x80;
    if (code < smallest || code > 0x10FFFF || (code >= 0xD800 && code <= 0xDFFF)) {
        return std::nullopt;
    }
    at += static_cast<std::size_t>(length);
    return code;
}

// The first byte at or after `at` that is not ASCII, or the size. Reads 32 bytes (or eight) at a
// time: most of the text is ASCII.
std::size_t asciiEnd(std::string_view bytes, std::size_t at) {
#if defined(__SSE2__)
    for (; at + 32 <= bytes.size(); at += 32) {
        const auto* block = reinterpret_cast<const __m128i*>(bytes.data() + at);
        if (_mm_movemask_epi8(_mm_or_si128(_mm_loadu_si128(block), _mm_loadu_si128(block + 1)))) {
            break;
        }
    }
#endif
    constexpr std::uint64_t kHighBits = 0x8080808080808080u;
    for (; at + 8 <= bytes.size(); at += 8) {
        std::uint64_t word;
        std::memcpy(&word, bytes.data() + at, 8);
        if ((word & kHighBits) != 0) break;
    }
    while (at < bytes.size() && static_cast<unsigned char>(bytes[at]) < 0x80) ++at;
    return at;
}

}  // namespace

bool isAscii(std::string_view bytes) {
    return asciiEnd(bytes, 0) == bytes.size();
}

bool isUtf8(std::string_view bytes) {
    for (std::size_t at = asciiEnd(bytes, 0); at < bytes.size(); at = asciiEnd(bytes, at)) {
        if (!decodeOne(bytes, at)) return false;
    }
    return true;
}

char* writeAsLatin1(char* to, std::string_view utf8, char32_t* outside) {
    for (std::size_t at = 0; at < utf8.size();) {
        const std::size_t ascii = asciiEnd(utf8, at);
        if (ascii > at) std::memcpy(to, utf8.data() + at, ascii - at);
        to += ascii - at;
        at = ascii;
        if (at == utf8.size()) break;
        const std::optional<char32_t> code = decodeOne(utf8, at);
        if (!code || *code > 0xFF) {
            if (outside != nullptr) *outside = code.value_or(0xFFFD);
            return nullptr;
        }
        *to++ = static_cast<char>(*code);
    }
    return to;
}

bool appendAsLatin1(std::string& out, std::string_view utf8, char32_t* outside) {
    const std::size_t before = out.size();
    out.resize(before + utf8.size());
    char* const end = writeAsLatin1(out.data() + before, utf8, outside);
    out.resize(end == nullptr ? before : static_cast<std::size_t>(end - out.data()));
    return end != nullptr;
}

std::optional<std::string> utf8ToLatin1(std::string_view utf8, char32_t* outside) {
    std::string latin1;
    latin1.reserve(utf8.size());
    if (!appendAsLatin1(latin1, utf8, outside)) return std::nullopt;
    return latin1;
}

}  // namespace catalogue
