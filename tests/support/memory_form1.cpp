#include "tests/support/memory_form1.h"

#include <gtest/gtest.h>

namespace test_support {

MainWindowFixture::MainWindowFixture()
    : store(folder.path(), sys),
      form(std::make_unique<main_window::Form1>(view.controls(), platform, store)),
      newList(newListView.controls(), platform, store, *form),
      exporter(exportView.controls(), platform, store, *form) {
    folder.put("type.dat", "Types\r\nMusic CD\r\nDVD video\r\nGame\r\n");
    folder.put("information.dat", "Information\r\nOriginal\r\nCopy\r\n");
    folder.put("pemla.dat", "");
    form->setDialogs({&newListView.window, &exportView.window, nullptr});
}

bool MainWindowFixture::pick(ui::memory::MemoryListBox& box, const std::string& item) {
    const bool shown = box.userSelect(item);
    EXPECT_TRUE(shown) << "not shown: " << item;
    return shown;
}

void MainWindowFixture::fill(const catalogue::Entry& e) {
    retype(view.Text1, e.title);
    retype(view.Combo1, e.type);
    retype(view.Combo2, e.discs);
    retype(view.Combo3, e.information);
}

void MainWindowFixture::addDylan(const std::string& information) {
    fill({"Dylan", "Game", "1", information});
    press(view.Command_add, {ui::Answer::Ok});
}

void MainWindowFixture::deleteList() {
    press(view.Command_delete, {ui::Answer::Yes, ui::Answer::Yes, ui::Answer::Ok});
}

void MainWindowFixture::createList(const std::string& name) {
    view.Command_create.click();
    newListView.Text1.type(name);
    newListView.Command1.click();
}

Files MainWindowFixture::files() const {
    Files files = snapshot(folder.path());
    files.merge(snapshot(out.path(), "out/"));
    for (auto& [name, bytes] : files) {
        for (std::size_t at; (at = bytes.find(out.path())) != std::string::npos;) {
            bytes.replace(at, out.path().size(), "<out>");
        }
    }
    return files;
}

std::vector<ui::memory::MemoryPlatform::Shown> MainWindowFixture::errors() const {
    std::vector<ui::memory::MemoryPlatform::Shown> shown;
    for (const auto& box : platform.shown()) {
        if (box.title == "Error") shown.push_back(box);
    }
    return shown;
}

void MainWindowFixture::expectBox(std::size_t before, int style, const std::string& title,
                                  const std::string& prompt) const {
    const auto& shown = platform.shown();
    ASSERT_EQ(shown.size(), before + 1);
    EXPECT_EQ(shown.back().style, style);
    EXPECT_EQ(shown.back().title, title);
    if (!prompt.empty()) {
        EXPECT_EQ(shown.back().prompt, prompt);
    }
}

}  // namespace test_support
