#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/support/memory_form1.h"

// The main window's tests: a catalogue folder with the list "Rock", the entry fields as the
// user sees them, and the message boxes shown. A box the test did not script an answer for
// fails the test, so a test that scripts none also proves that none was shown.
namespace main_window_test {

using Strings = std::vector<std::string>;
using namespace test_support;  // the window tests speak of the catalogue folder's files
using ui::Answer;

class Form1Test : public ::testing::Test, public test_support::MainWindowFixture {
  protected:
    void startWithRock(const Strings& others = {}) {
        putRock(folder, others);
        start();
        open("Rock");
    }

    Strings titles() const { return view.List1.items(); }
    std::string fields() const {
        return view.Text1.text() + "|" + view.Combo1.text() + "|" + view.Combo2.text() + "|" +
               view.Combo3.text() + "|" + view.Textart.text();
    }
    void expectReset() const {
        EXPECT_EQ(fields(), "|Select type|Disc(s)|Info|");
        EXPECT_EQ(view.List1.selectedIndex(), -1);
    }
};

}  // namespace main_window_test
