// Files and folders the program may not write, and a full disk. As root, permission bits stop
// nothing, so each test first proves that its obstacle really holds here, or skips saying why.
// Short writes ending in a full disk at every write of a commit are the catalogue suite's.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/mount.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <filesystem>

#include "tests/faults/fault_rig.h"

namespace faults {
namespace {

const std::string kWithDylan = kAbbaDat + entryText({{"Dylan", "Game", "1", "x"}});

// Whether a file can be created and written in the folder right now; errno tells why not.
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

// The one error box shown ends with the system's reason.
void expectOneError(const Rig& r, int errnum) {
    ASSERT_EQ(r.errors().size(), 1u);
    EXPECT_TRUE(
        r.errors().front().prompt.ends_with(":\r\n" + std::string(std::strerror(errnum)) + "."))
        << r.errors().front().prompt;
}

TEST(ReadOnly, AFileWithEveryWriteBitClearedIsRefusedByTheStoreItself) {
    Rig r;
    r.putRock();
    ::chmod((r.folder + "/Rock.art").c_str(), 0444);
    // Root could write it all the same: the refusal is the program's own.
    EXPECT_TRUE(::geteuid() != 0 || ::access((r.folder + "/Rock.art").c_str(), W_OK) == 0);
    const Files before = r.files();
    r.start();
    ASSERT_TRUE(r.open("Rock"));
    r.addDylan();
    ASSERT_EQ(r.errors().size(), 1u);
    EXPECT_EQ(r.errors().front().prompt, "The file \"Rock.art\" could not be used:\r\n" +
                                             std::string(std::strerror(EACCES)) + ".");
    // Deleting the list would delete the protected file: refused as well.
    r.deleteList();
    EXPECT_EQ(r.errors().size(), 2u);
    EXPECT_EQ(r.files(), before) << difference(before, r.files());
    ::chmod((r.folder + "/Rock.art").c_str(), 0644);
    r.addDylan();
    EXPECT_EQ(r.files().at("Rock.dat"), kWithDylan);
}

// Root becomes an unprivileged user for as long as this lives; the saved user id brings it back.
constexpr uid_t kNobody = 65534;
struct AsNobody {
    AsNobody() : root(::geteuid() == 0) {
        failed = root && (::setegid(kNobody) != 0 || ::seteuid(kNobody) != 0);
    }
    ~AsNobody() {
        if (root && (::seteuid(0) != 0 || ::setegid(0) != 0)) std::abort();
    }
    bool root, failed;
};

TEST(ReadOnly, AFolderTheUserMayNotWriteInIsRefusedAndLeftAsItWas) {
    Rig r;
    r.putRock();
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
    {
        AsNobody nobody;
        if (nobody.failed) GTEST_SKIP() << "cannot become an unprivileged user here";
        if (canCreateIn(r.folder)) GTEST_SKIP() << "a read-only folder takes new files here";
        ASSERT_EQ(errno, EACCES);
        r.addDylan();
    }
    expectOneError(r, EACCES);
    EXPECT_TRUE(r.errors().front().prompt.starts_with("The file \"Rock.")) << r.errors()[0].prompt;
    EXPECT_EQ(snapshot(r.folder), before) << difference(before, snapshot(r.folder));
}

// A memory file system of a few pages, mounted for one test and taken away after it.
struct SmallDisk {
    SmallDisk() : path(base.path() + "/disk") {
        std::filesystem::create_directory(path);
        if (::mount("pemla-test", path.c_str(), "tmpfs", MS_NOSUID | MS_NODEV, "size=64k") != 0) {
            why = std::strerror(errno);
        }
    }
    ~SmallDisk() {
        if (why.empty()) ::umount2(path.c_str(), MNT_DETACH);
    }
    test_support::TempFolder base;
    std::string path, why;
};

TEST(FullDisk, AFullFileSystemLeavesTheOldFilesAndTheSameChangeWorksOnceThereIsRoom) {
    SmallDisk disk;
    if (!disk.why.empty()) GTEST_SKIP() << "cannot mount a small tmpfs here: " << disk.why;
    Rig r(disk.path);
    r.put("type.dat", "Types\r\nGame\r\n");
    r.put("information.dat", "Information\r\nCopy\r\n");
    r.putRock();
    // Fill what is left, then prove that not even a few bytes fit any more.
    const std::string filler = disk.path + "/filler";
    const int fd = ::open(filler.c_str(), O_WRONLY | O_CREAT, 0644);
    ASSERT_GE(fd, 0);
    const std::string block(4096, 'f');
    for (std::size_t size : {block.size(), std::size_t{1}}) {
        while (::write(fd, block.data(), size) > 0) {
        }
    }
    ::close(fd);
    ASSERT_FALSE(canCreateIn(disk.path));
    ASSERT_EQ(errno, ENOSPC);
    const Files before = r.files();
    r.start();
    ASSERT_TRUE(r.open("Rock"));
    r.addDylan();
    expectOneError(r, ENOSPC);
    EXPECT_EQ(r.files(), before) << difference(before, r.files());
    ::unlink(filler.c_str());
    r.addDylan();
    EXPECT_EQ(r.files().at("Rock.dat"), kWithDylan);
    EXPECT_FALSE(hasLeftovers(r.files()));
}

}  // namespace
}  // namespace faults
