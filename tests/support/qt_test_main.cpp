#include <gtest/gtest.h>

#include <QApplication>
#include <cstdlib>

// Qt tests need no display: they run on the offscreen platform unless told otherwise. This is set
// here, not by ctest, because test discovery runs the binary outside ctest.
int main(int argc, char** argv) {
    setenv("QT_QPA_PLATFORM", "offscreen", 0);
    QApplication application(argc, argv);
    ::testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
