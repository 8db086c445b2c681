// The start-up without a display: the command line, and choosing and preparing the data folder.
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <map>

#include "app/command_line.h"
#include "app/data_folder.h"
#include "catalogue/catalogue_error.h"
#include "tests/support/temp_folder.h"

namespace {

using Action = app::CommandLine::Action;

std::string bytesOf(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    return std::string(std::istreambuf_iterator<char>(in), {});
}

app::CommandLine parse(std::vector<const char*> arguments) {
    arguments.insert(arguments.begin(), "pemla");
    return app::parseCommandLine(static_cast<int>(arguments.size()), arguments.data());
}

TEST(StartUp, CommandLine) {
    struct Case {
        std::vector<const char*> arguments;
        Action action;
        std::optional<std::string> data;
        const char* output;  // a part of the output
    };
    const Case cases[] = {
        {{}, Action::Run, std::nullopt, ""},
        {{"--help"}, Action::Help, std::nullopt, "--data <folder>"},
        {{"-h"}, Action::Help, std::nullopt, "Usage: pemla [options]"},
        {{"--version"}, Action::Version, std::nullopt, "pemla 0.90\n"},
        {{"--data", "/d"}, Action::Run, "/d", ""},
        {{"--data=rel/x", "--data", "/last"}, Action::Run, "/last", ""},
        // Bytes that are no UTF-8 still name the same folder.
        {{"--data", "/caf\xe9/\xff"}, Action::Run, "/caf\xe9/\xff", ""},
        {{"-platform", "offscreen"}, Action::Run, std::nullopt, ""},
        {{"--bogus"}, Action::Error, std::nullopt, "pemla: Unknown option 'bogus'.\nUsage:"},
        {{"--data"}, Action::Error, std::nullopt, "Missing value after '--data'"},
        {{"list"}, Action::Error, std::nullopt, "Unexpected argument 'list'"},
    };
    for (const Case& c : cases) {
        const app::CommandLine line = parse(c.arguments);
        const std::string shown = c.arguments.empty() ? "(none)" : c.arguments[0];
        EXPECT_EQ(line.action, c.action) << shown;
        EXPECT_EQ(line.dataFolder, c.data) << shown;
        EXPECT_NE(line.output.find(c.output), std::string::npos) << shown << ": " << line.output;
    }
    EXPECT_EQ(parse({"a\xe9"}).positional, std::vector<std::string>{"a\xe9"});
}

TEST(StartUp, ChoosingTheDataFolder) {
    using Env = std::map<std::string, std::string>;
    struct Case {
        std::optional<std::string> option;
        Env env;
        std::string folder;  // empty: refused
    };
    const std::string here = std::filesystem::current_path().string();
    const Case cases[] = {
        {"/opt", {{"PEMLA_DATA", "/p"}, {"HOME", "/h"}}, "/opt"},
        {"rel", {}, here + "/rel"},
        {std::nullopt, {{"PEMLA_DATA", "/p"}, {"XDG_DATA_HOME", "/x"}, {"HOME", "/h"}}, "/p"},
        {std::nullopt, {{"PEMLA_DATA", ""}, {"XDG_DATA_HOME", "/x"}, {"HOME", "/h"}}, "/x/pemla"},
        {std::nullopt, {{"XDG_DATA_HOME", "x"}, {"HOME", "/h"}}, "/h/.local/share/pemla"},
        {std::nullopt, {{"HOME", ""}}, ""},
        {"", {{"HOME", "/h"}}, ""},
    };
    for (const Case& c : cases) {
        const app::Environment env = [&](const char* name) -> std::optional<std::string> {
            const auto found = c.env.find(name);
            if (found == c.env.end()) return std::nullopt;
            return found->second;
        };
        if (c.folder.empty()) {
            EXPECT_THROW(app::chooseDataFolder(c.option, env), catalogue::CatalogueError);
        } else {
            EXPECT_EQ(app::chooseDataFolder(c.option, env), c.folder);
        }
    }
}

TEST(StartUp, PreparingTheDataFolder) {
    test_support::TempFolder supplied;
    supplied.put("type.dat", "Types\r\nDVD\r\n");
    supplied.put("information.dat", "Info\r\nOriginal\r\n");
    test_support::TempFolder root;

    // A new folder, two levels deep, gets every file; an existing one keeps its own, even a link.
    const std::string fresh = root.file("a/b");
    app::prepareDataFolder(fresh, supplied.path());
    test_support::TempFolder kept;
    kept.put("type.dat", "Mine\r\n");
    ASSERT_EQ(::symlink("nowhere", kept.file("pemla.dat").c_str()), 0);
    app::prepareDataFolder(kept.path(), supplied.path());
    for (const std::string& folder : {fresh, kept.path()}) {
        const auto read = [&](const char* name) { return bytesOf(folder + "/" + name); };
        EXPECT_EQ(read("information.dat"), "Info\r\nOriginal\r\n");
    }
    EXPECT_EQ(bytesOf(fresh + "/type.dat"), "Types\r\nDVD\r\n");
    EXPECT_EQ(bytesOf(fresh + "/pemla.dat"), "");
    EXPECT_EQ(kept.get("type.dat"), "Mine\r\n");
    char target[16] = {};
    EXPECT_EQ(::readlink(kept.file("pemla.dat").c_str(), target, sizeof target - 1), 7);

    // What cannot be prepared is refused, naming what failed.
    root.put("file", "");
    test_support::TempFolder lacking;
    const std::pair<std::string, std::string> refused[] = {
        {root.file("file/sub"), root.file("file/sub")},
        {root.file("file"), root.file("file")},
        {lacking.path(), supplied.file("type.dat")},  // a damaged install
    };
    supplied.put("type.dat", "");
    ::unlink(supplied.file("type.dat").c_str());
    for (const auto& [folder, named] : refused) {
        try {
            app::prepareDataFolder(folder, supplied.path());
            ADD_FAILURE() << folder;
        } catch (const catalogue::CatalogueError& e) {
            EXPECT_EQ(e.file(), named);
            EXPECT_FALSE(e.reason().empty());
        }
    }
    EXPECT_EQ(lacking.listing(), "");
}

}  // namespace
