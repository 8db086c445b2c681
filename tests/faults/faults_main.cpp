// The fault tests make thousands of commits, each with several fsyncs: on a disk that is about
// 10 ms a commit, on a memory file system nothing. A kill or a failed call behaves the same on
// both, so the catalogue folders go to /dev/shm where there is one.
#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdlib>

int main(int argc, char** argv) {
    if (::access("/dev/shm", W_OK | X_OK) == 0) ::setenv("TMPDIR", "/dev/shm", 1);
    ::testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
