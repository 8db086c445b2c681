// Files and folders the program may not write, and a full disk. As root, permission bits stop
// nothing, so each test first proves that its obstacle really holds here, or skips saying why.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/mount.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <iostream>

#include "tests/faults/fault_rig.h"

namespace faults {
namespace {

using ui::Answer;

const std::string kRockDat = entryText({{"Abba Gold", "Music CD", "1", "Original"}});
const std::string kAdded = entryText({{"Dylan", "Game", "1", "x"}});

void putRock(const Rig& r) {
    r.putList("Rock", kRockDat, crlf({"Abba Gold#*\\A001"}), crlf({"A#002"}));
    r.put("pemla.dat", crlf({"Rock"}));
}

// The user adds "Dylan" to the open list "Rock", an error box scripted in case.
void addDylan(Rig& r) {
    r.platform.answer(Answer::Ok);
    r.fill("Dylan", "Game", "1", "x");
    r.view.Command_add.click();
}

// Whether a file can be created in the folder right now; errno tells why not.
bool canCreateIn(const std::string& folder) {
    const std::string probe = folder + "/can-i-write";
    const int fd = ::open(probe.c_str(), O_WRONLY | O_CREAT | O_EXCL, 0644);
    if (fd < 0) return false;
    const bool wrote = ::write(fd, "0123456789", 10) == 10;
    const int err = errno;
    ::close(fd);
    ::unlink(probe.c_str());
    errno = err;
    return wrote;
}

TEST(ReadOnly, AFileWithEveryWriteBitClearedIsRefusedByTheStoreItself) {
    Rig r;
    putRock(r);
    ::chmod((r.folder + "/Rock.art").c_str(), 0444);
    // Root could write it all the same: the refusal is the program's own.
    if (::geteuid() == 0) {
        const int fd = ::open((r.folder + "/Rock.art").c_str(), O_WRONLY | O_APPEND);
        EXPECT_GE(fd, 0);
        ::close(fd);
    }
    const Files before = r.files();
    r.start();
    ASSERT_TRUE(r.open("Rock"));
    addDylan(r);
    ASSERT_EQ(r.errors().size(), 1u);
    EXPECT_EQ(r.errors().front().prompt, "The file \"Rock.art\" could not be used:\r\n" +
                                             std::string(std::strerror(EACCES)) + ".");
    EXPECT_EQ(r.files(), before) << difference(before, r.files());
    // Deleting the list would delete the protected file: refused as well.
    r.platform.answer(Answer::Yes);
    r.platform.answer(Answer::Yes);
    r.platform.answer(Answer::Ok);
    r.view.Command_delete.click();
    EXPECT_EQ(r.errors().size(), 2u);
    EXPECT_EQ(r.files(), before) << difference(before, r.files());
    ::chmod((r.folder + "/Rock.art").c_str(), 0644);
    addDylan(r);
    EXPECT_EQ(r.files().at("Rock.dat"), kRockDat + kAdded);
}

// What the child reports back through a pipe: "ok", "skip: why" or what went wrong.
std::string reportFromChild(const std::function<std::string()>& body) {
    int fds[2];
    if (::pipe(fds) != 0) return std::string("pipe: ") + std::strerror(errno);
    const int status = inChild([&] {
        ::close(fds[0]);
        std::string said;
        try {
            said = body();
        } catch (const ui::memory::UnscriptedMessageBox& box) {
            said = "unscripted box: " + box.prompt;
        } catch (const std::exception& e) {
            said = std::string("exception: ") + e.what();
        }
        if (::write(fds[1], said.data(), said.size()) < 0) ::_exit(101);
    });
    ::close(fds[1]);
    std::string said;
    char buffer[512];
    for (ssize_t got; (got = ::read(fds[0], buffer, sizeof buffer)) > 0;) said.append(buffer, got);
    ::close(fds[0]);
    return said.empty() ? "child ended silently: " + describeStatus(status) : said;
}

TEST(ReadOnly, AFolderTheUserMayNotWriteInIsRefusedAndLeftAsItWas) {
    constexpr uid_t kNobody = 65534;
    Rig r;
    putRock(r);
    // The catalogue folder alone: the rig's output folder stays root's.
    const Files before = snapshot(r.folder);
    r.start();
    ASSERT_TRUE(r.open("Rock"));
    if (::geteuid() == 0) {
        for (const auto& item : std::filesystem::directory_iterator(r.folder)) {
            ASSERT_EQ(::chown(item.path().c_str(), kNobody, kNobody), 0);
        }
        ASSERT_EQ(::chown(r.folder.c_str(), kNobody, kNobody), 0);
    }
    ASSERT_EQ(::chmod(r.folder.c_str(), 0555), 0);
    const std::string said = reportFromChild([&]() -> std::string {
        if (::geteuid() == 0 && (::setgid(kNobody) != 0 || ::setuid(kNobody) != 0)) {
            return std::string("skip: cannot become an unprivileged user: ") + std::strerror(errno);
        }
        if (canCreateIn(r.folder)) return "skip: the read-only folder takes new files here";
        if (errno != EACCES) return std::string("unexpected: ") + std::strerror(errno);
        addDylan(r);
        if (r.errors().size() != 1) return "boxes: " + std::to_string(r.errors().size());
        if (!r.errors().front().prompt.starts_with("The file \"Rock.")) {
            return "box: " + r.errors().front().prompt;
        }
        const Files after = snapshot(r.folder);
        return after == before ? "ok" : "changed:" + difference(before, after);
    });
    ::chmod(r.folder.c_str(), 0755);
    if (said.starts_with("skip: ")) GTEST_SKIP() << said.substr(6);
    EXPECT_EQ(said, "ok");
    EXPECT_EQ(snapshot(r.folder), before);
}

// A memory file system of a few pages, mounted for one test and taken away after it.
class SmallDisk {
  public:
    SmallDisk() : point_(base_.path() + "/disk") {
        std::filesystem::create_directory(point_);
        if (::mount("pemla-test", point_.c_str(), "tmpfs", MS_NOSUID | MS_NODEV, "size=64k") != 0) {
            why_ = std::strerror(errno);
        }
    }
    ~SmallDisk() {
        if (why_.empty()) ::umount2(point_.c_str(), MNT_DETACH);
    }
    bool mounted() const { return why_.empty(); }
    const std::string& why() const { return why_; }
    const std::string& path() const { return point_; }

  private:
    test_support::TempFolder base_;
    std::string point_;
    std::string why_;
};

TEST(FullDisk, AFullFileSystemLeavesTheOldFilesAndTheSameChangeWorksOnceThereIsRoom) {
    SmallDisk disk;
    if (!disk.mounted()) GTEST_SKIP() << "cannot mount a small tmpfs here: " << disk.why();
    Rig r(disk.path());
    r.put("type.dat", "Types\r\nGame\r\n");
    r.put("information.dat", "Information\r\nCopy\r\n");
    putRock(r);
    // Fill what is left, then prove that not even a few bytes fit any more.
    const std::string filler = disk.path() + "/filler";
    const int fd = ::open(filler.c_str(), O_WRONLY | O_CREAT, 0644);
    ASSERT_GE(fd, 0);
    const std::string block(4096, 'f');
    while (::write(fd, block.data(), block.size()) > 0) {
    }
    while (::write(fd, block.data(), 1) > 0) {
    }
    ::close(fd);
    ASSERT_FALSE(canCreateIn(disk.path()));
    ASSERT_EQ(errno, ENOSPC);
    Files before = r.files();
    r.start();
    ASSERT_TRUE(r.open("Rock"));
    addDylan(r);
    ASSERT_EQ(r.errors().size(), 1u);
    EXPECT_TRUE(r.errors().front().prompt.ends_with(std::string(std::strerror(ENOSPC)) + "."))
        << r.errors().front().prompt;
    EXPECT_EQ(r.files(), before) << difference(before, r.files());
    ::unlink(filler.c_str());
    addDylan(r);
    EXPECT_EQ(r.files().at("Rock.dat"), kRockDat + kAdded);
    EXPECT_TRUE(leftovers(r.files()).empty());
}

// Without a mount: the system seam moves a few bytes per write, then reports the disk full.
TEST(FullDisk, ShortWritesEndingInNoSpaceLeaveTheOldFiles) {
    for (int n = 1; n <= 4; ++n) {
        SCOPED_TRACE("no space at write #" + std::to_string(n));
        Rig r;
        putRock(r);
        const Files before = r.files();
        r.start();
        ASSERT_TRUE(r.open("Rock"));
        test_support::FaultySys full;
        full.capWrites(7);
        full.failAt(test_support::SysCall::Write, n, ENOSPC);
        r.sys.use(full, &full);
        addDylan(r);
        r.sys.reset();
        ASSERT_TRUE(full.fired());
        ASSERT_EQ(r.errors().size(), 1u);
        EXPECT_TRUE(r.errors().front().prompt.ends_with(std::string(std::strerror(ENOSPC)) + "."));
        EXPECT_EQ(r.files(), before) << difference(before, r.files());
    }
}

}  // namespace
}  // namespace faults
