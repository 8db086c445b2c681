// The start-up without a display: the command line, and choosing and preparing the data folder.
// What the installed program prints and leaves behind is checked by the install test.
#include <gtest/gtest.h>
#include <unistd.h>

#include <filesystem>
#include <map>

#include "app/command_line.h"
#include "app/data_folder.h"
#include "catalogue/catalogue_error.h"
#include "tests/support/temp_folder.h"

namespace {

using Action = app::CommandLine::Action;

TEST(StartUpOptions, CommandLine) {
    const struct {
        std::vector<const char*> arguments;
        Action action;
        std::optional<std::string> data;
    } cases[] = {
        {{"pemla"}, Action::Run, std::nullopt},
        {{"pemla", "-h"}, Action::Help, std::nullopt},
        {{"pemla", "--data=rel/x", "--data", "/last"}, Action::Run, "/last"},
        // Bytes that are no UTF-8 still name the same folder.
        {{"pemla", "--data", "/caf\xe9/\xff"}, Action::Run, "/caf\xe9/\xff"},
        {{"pemla", "-platform", "offscreen"}, Action::Run, std::nullopt},
        {{"pemla", "--data"}, Action::Error, std::nullopt},
        {{"pemla", "a\xe9"}, Action::Error, std::nullopt},
    };
    for (const auto& c : cases) {
        const app::CommandLine line =
            app::parseCommandLine(static_cast<int>(c.arguments.size()), c.arguments.data());
        EXPECT_EQ(line.action, c.action) << c.arguments.back();
        EXPECT_EQ(line.dataFolder, c.data) << c.arguments.back();
        EXPECT_EQ(line.output.starts_with("Usage: pemla [options]\n"), c.action == Action::Help);
    }
    const char* list[] = {"pemla", "a\xe9"};
    EXPECT_EQ(app::parseCommandLine(2, list).positional, std::vector<std::string>{"a\xe9"});
}

TEST(StartUpOptions, ChoosingTheDataFolder) {
    const std::string here = std::filesystem::current_path().string();
    const struct {
        std::optional<std::string> option;
        std::map<std::string, std::string> env;
        std::string folder;  // empty: refused
    } cases[] = {
        {"/opt", {{"PEMLA_DATA", "/p"}, {"HOME", "/h"}}, "/opt"},
        {"rel", {}, here + "/rel"},
        {std::nullopt, {{"PEMLA_DATA", "/p"}, {"XDG_DATA_HOME", "/x"}, {"HOME", "/h"}}, "/p"},
        {std::nullopt, {{"PEMLA_DATA", ""}, {"XDG_DATA_HOME", "/x"}, {"HOME", "/h"}}, "/x/pemla"},
        {std::nullopt, {{"XDG_DATA_HOME", "x"}, {"HOME", "/h"}}, "/h/.local/share/pemla"},
        {std::nullopt, {{"HOME", ""}}, ""},
        {"", {{"HOME", "/h"}}, ""},
    };
    for (const auto& c : cases) {
        const app::Environment env = [&](const char* name) -> std::optional<std::string> {
            if (!c.env.contains(name)) return std::nullopt;
            return c.env.at(name);
        };
        if (c.folder.empty()) {
            EXPECT_THROW(app::chooseDataFolder(c.option, env), catalogue::CatalogueError);
        } else {
            EXPECT_EQ(app::chooseDataFolder(c.option, env), c.folder);
        }
    }
}

TEST(StartUpOptions, PreparingTheDataFolder) {
    test_support::TempFolder supplied, data;
    supplied.put("type.dat", "Types\r\nDVD\r\n");
    supplied.put("information.dat", "Info\r\n");
    // What is there is kept, even a link; what is missing is supplied.
    data.put("type.dat", "Mine\r\n");
    ASSERT_EQ(::symlink("nowhere", data.file("pemla.dat").c_str()), 0);
    app::prepareDataFolder(data.path(), supplied.path());
    EXPECT_EQ(data.get("type.dat"), "Mine\r\n");
    EXPECT_EQ(data.get("information.dat"), "Info\r\n");
    EXPECT_TRUE(std::filesystem::is_symlink(data.file("pemla.dat")));

    // A damaged install is refused, naming the file it lacks, and nothing is left behind. (A
    // folder that cannot be made is named by the installed program, in the install test.)
    ::unlink(supplied.file("type.dat").c_str());
    test_support::TempFolder fresh;
    try {
        app::prepareDataFolder(fresh.file("new"), supplied.path());
        ADD_FAILURE() << "a damaged install was taken";
    } catch (const catalogue::CatalogueError& e) {
        EXPECT_EQ(e.file(), supplied.file("type.dat"));
    }
    EXPECT_EQ(std::filesystem::directory_iterator(fresh.file("new")),
              std::filesystem::directory_iterator());
}

}  // namespace
