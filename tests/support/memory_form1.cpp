#include "tests/support/memory_form1.h"

#include <gtest/gtest.h>

namespace test_support {

MemoryForm1::MemoryForm1() {
    for (ui::memory::Owned* control : std::initializer_list<ui::memory::Owned*>{
             &List_list, &Command_create, &Command_delete, &List1, &Command_search,
             &Command_delentry, &Command_export, &Command_print, &Text1, &Combo1, &Combo2, &Combo3,
             &Textart, &Command_add, &Command_change, &Command_clear}) {
        control->setOwner(&window);
    }
}

main_window::Form1Controls MemoryForm1::controls() {
    return {window,      Label1,         List_list,        Command_create, Command_delete, Label2,
            List1,       Command_search, Command_delentry, Command_export, Command_print,  Label4,
            Text1,       Combo1,         Combo2,           Combo3,         Label3,         Textart,
            Command_add, Command_change, Command_clear};
}

MainWindowFixture::MainWindowFixture() : store(folder.path()) {
    folder.put("type.dat", "Types\r\nMusic CD\r\nDVD video\r\nGame\r\n");
    folder.put("information.dat", "Information\r\nOriginal\r\nCopy\r\n");
    folder.put("pemla.dat", "");
    form = std::make_unique<main_window::Form1>(view.controls(), platform, store);
}

void MainWindowFixture::putList(const std::string& name, const std::string& entries,
                                const std::string& articles, const std::string& counter,
                                const std::string& flag) {
    folder.put(name + ".dat", entries);
    folder.put(name + ".art", articles);
    folder.put(name + ".arn", counter);
    if (!flag.empty()) folder.put(name + ".inf", flag);
}

void MainWindowFixture::start() {
    view.window.show();
}

void MainWindowFixture::open(const std::string& list) {
    ASSERT_TRUE(view.List_list.userSelect(list)) << "no list " << list;
}

}  // namespace test_support
