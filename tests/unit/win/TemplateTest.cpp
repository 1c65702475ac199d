#include "platform/win/AcceleratorTemplate.h"
#include "platform/win/DialogTemplate.h"
#include "platform/win/MenuTemplate.h"
#include "platform/win/Resource.h"
#include "platform/win/ToolBarTemplate.h"
#include "tests/data/resources/resource.h"
#include "tests/unit/win/Damage.h"

#include <afxres.h>

using namespace tvx;

namespace {

ResourceBytes bytesOf(int id, LPCSTR type) {
    return resourceBytes(nullptr, MAKEINTRESOURCE(id), type);
}

} // namespace

TEST(DialogTemplate, ExtendedOneIsReadWhole) {
    const auto dialog = parseDialogTemplate(bytesOf(IDD_SAMPLE, RT_DIALOG));
    ASSERT_TRUE(dialog) << dialog.reason();
    EXPECT_TRUE(dialog->extended);
    EXPECT_EQ(dialog->style, DS_SETFONT | DS_MODALFRAME | WS_POPUP | WS_CAPTION | WS_SYSMENU);
    EXPECT_EQ(dialog->extendedStyle, DWORD{WS_EX_CONTEXTHELP});
    EXPECT_EQ(dialog->rect.y, 20);
    EXPECT_EQ(dialog->rect.width, 186);
    EXPECT_EQ(dialog->title, "Überblick");
    EXPECT_EQ(dialog->menu, ResourceName(WORD{0}));
    ASSERT_TRUE(dialog->font);
    EXPECT_EQ(dialog->font->pointSize, 8);
    EXPECT_EQ(dialog->font->weight, 700);
    EXPECT_TRUE(dialog->font->italic);
    EXPECT_EQ(dialog->font->faceName, "MS Shell Dlg");
}

TEST(DialogTemplate, ControlsComeInTabOrderWithTheirClasses) {
    const auto dialog = parseDialogTemplate(bytesOf(IDD_SAMPLE, RT_DIALOG));
    ASSERT_TRUE(dialog) << dialog.reason();
    const auto& items = dialog->items;
    ASSERT_EQ(items.size(), 7u);
    EXPECT_EQ(items[0].className, "Button");
    EXPECT_EQ(items[0].style, BS_DEFPUSHBUTTON | WS_CHILD | WS_VISIBLE | WS_TABSTOP);
    EXPECT_EQ(textOf(items[1].title), "Say \"yes\"");
    EXPECT_EQ(items[1].id, 0xFFFFu);
    EXPECT_EQ(items[1].rect.y, -9);
    EXPECT_EQ(items[2].className, "Edit");
    EXPECT_EQ(items[2].style & WS_BORDER, 0u);
    EXPECT_EQ(items[3].className, "ComboBox");
    EXPECT_EQ(items[3].rect.height, 100);
    EXPECT_EQ(items[4].className, "ListBox");
    EXPECT_EQ(items[5].className, "SysTreeView32");
    EXPECT_EQ(items[5].extendedStyle, DWORD{WS_EX_CLIENTEDGE});
    EXPECT_EQ(items[5].helpId, 42u);
    EXPECT_EQ(items[6].title, ResourceName(WORD{IDI_SPOT}));
}

TEST(DialogTemplate, PlainOneHasItsOwnLayout) {
    const auto dialog = parseDialogTemplate(bytesOf(IDD_PLAIN, RT_DIALOG));
    ASSERT_TRUE(dialog) << dialog.reason();
    EXPECT_FALSE(dialog->extended);
    EXPECT_FALSE(dialog->font);
    EXPECT_EQ(textOf(dialog->className), "Custom");
    ASSERT_EQ(dialog->items.size(), 2u);
    EXPECT_EQ(dialog->items[0].id, DWORD{IDCANCEL});
    EXPECT_EQ(dialog->items[0].style & WS_TABSTOP, 0u);
    EXPECT_EQ(dialog->items[1].id, 0xFFFFu);
    EXPECT_EQ(dialog->items[1].rect.height, 8);
}

TEST(DialogTemplate, DamagedOnesAreRefused) {
    for (const int id : {IDD_SAMPLE, IDD_PLAIN}) {
        const ResourceBytes data = bytesOf(id, RT_DIALOG);
        expectTruncationsRefused(data, data.size(), parseDialogTemplate);
        parseWithFlippedBits(data, parseDialogTemplate);
    }
    const auto cut = parseDialogTemplate(bytesOf(IDD_SAMPLE, RT_DIALOG).first(160));
    EXPECT_EQ(cut.reason(), "dialog template ends within control 2 of 7");
}

TEST(DialogData, TextsOfListsAreUtf8) {
    const auto entries = parseDialogData(bytesOf(IDD_SAMPLE, RT_DLGINIT));
    ASSERT_TRUE(entries) << entries.reason();
    ASSERT_EQ(entries->size(), 3u);
    EXPECT_EQ((*entries)[0].controlId, IDC_COLOR);
    EXPECT_EQ((*entries)[0].kind, DialogDataEntry::Kind::AddToComboBox);
    EXPECT_EQ((*entries)[0].text, "red");
    EXPECT_EQ((*entries)[1].text, "gelb ß");
    EXPECT_EQ((*entries)[2].kind, DialogDataEntry::Kind::AddToListBox);
    EXPECT_EQ((*entries)[2].text, "one");
}

TEST(DialogData, DamagedOnesAreRefused) {
    const ResourceBytes data = bytesOf(IDD_SAMPLE, RT_DLGINIT);
    expectTruncationsRefused(data, data.size(), parseDialogData);
    parseWithFlippedBits(data, parseDialogData);
}

TEST(MenuTemplate, PlainOneIsATree) {
    using Item = MenuItemTemplate;
    const auto menu = parseMenuTemplate(bytesOf(IDR_MAINFRAME, RT_MENU));
    ASSERT_TRUE(menu) << menu.reason();
    ASSERT_EQ(menu->size(), 3u);
    const Item& file = (*menu)[0];
    EXPECT_EQ(file.kind, Item::Kind::Popup);
    ASSERT_EQ(file.items.size(), 4u);
    EXPECT_EQ(file.items[0].text, "&New\tCtrl+N");
    EXPECT_EQ(file.items[0].id, UINT{ID_FILE_NEW});
    EXPECT_EQ(file.items[1].kind, Item::Kind::Separator);
    EXPECT_TRUE(file.items[2].grayed);
    EXPECT_TRUE(file.items[3].inactive);
    EXPECT_TRUE(file.items[3].items.at(0).checked);
    EXPECT_EQ((*menu)[1].breakBefore, Item::Break::Bar);
    EXPECT_TRUE((*menu)[2].help);
    EXPECT_EQ((*menu)[2].items.at(0).text, "&About Größe...");
}

TEST(MenuTemplate, ExtendedOneCarriesIdentifiersOfPopups) {
    using Item = MenuItemTemplate;
    const auto menu = parseMenuTemplate(bytesOf(IDR_EXTENDED, RT_MENU));
    ASSERT_TRUE(menu) << menu.reason();
    ASSERT_EQ(menu->size(), 2u);
    const Item& edit = (*menu)[0];
    EXPECT_EQ(edit.id, 500u);
    EXPECT_EQ(edit.helpId, 77u);
    ASSERT_EQ(edit.items.size(), 4u);
    EXPECT_TRUE(edit.items[0].grayed);
    EXPECT_EQ(edit.items[1].kind, Item::Kind::Separator);
    EXPECT_TRUE(edit.items[2].checked);
    EXPECT_TRUE(edit.items[2].grayed);
    EXPECT_EQ(edit.items[2].breakBefore, Item::Break::Column);
    EXPECT_EQ(edit.items[3].id, UINT{ID_EDIT_PASTE});
    EXPECT_EQ((*menu)[1].text, "Last");
}

TEST(MenuTemplate, DamagedOnesAreRefused) {
    for (const int id : {IDR_MAINFRAME, IDR_EXTENDED}) {
        const ResourceBytes data = bytesOf(id, RT_MENU);
        expectTruncationsRefused(data, data.size() - 1, parseMenuTemplate);
        parseWithFlippedBits(data, parseMenuTemplate);
    }
    // Popups without an end, each inside the one before.
    std::vector<std::uint8_t> deep(4);
    for (int i = 0; i < 100000; ++i) {
        deep.insert(deep.end(), {0x10, 0, 'a', 0, 0, 0});
    }
    EXPECT_EQ(parseMenuTemplate(deep).reason(), "menu nested deeper than 32 levels");
    const std::vector<std::uint8_t> newer = {2, 0, 0, 0};
    EXPECT_EQ(parseMenuTemplate(newer).reason(), "menu of the unknown version 2");
}

TEST(AcceleratorTemplate, KeysKeepTheirModifiers) {
    const auto table = parseAcceleratorTemplate(bytesOf(IDR_MAINFRAME, RT_ACCELERATOR));
    ASSERT_TRUE(table) << table.reason();
    ASSERT_EQ(table->size(), 2u);
    EXPECT_EQ((*table)[0].flags, 1 | 8);
    EXPECT_EQ((*table)[0].key, 'N');
    EXPECT_EQ((*table)[1].flags, 1 | 2 | 4);
    EXPECT_EQ((*table)[1].key, VK_F6);
    EXPECT_EQ((*table)[1].command, ID_NEXT_PANE);
}

TEST(AcceleratorTemplate, CharactersMayHaveModifiers) {
    const auto table = parseAcceleratorTemplate(bytesOf(IDR_EXTENDED, RT_ACCELERATOR));
    ASSERT_TRUE(table) << table.reason();
    ASSERT_EQ(table->size(), 3u);
    EXPECT_EQ((*table)[0].flags, 16);
    EXPECT_EQ((*table)[0].key, 'd');
    EXPECT_EQ((*table)[1].flags, 0);
    EXPECT_EQ((*table)[1].key, 'Q' & 0x1F);
    EXPECT_EQ((*table)[2].flags, 1 | 8 | 16);
    EXPECT_EQ((*table)[2].command, ID_EDIT_CLEAR);
}

TEST(AcceleratorTemplate, DamagedOnesAreRefused) {
    const ResourceBytes data = bytesOf(IDR_MAINFRAME, RT_ACCELERATOR);
    expectTruncationsRefused(data, data.size(), parseAcceleratorTemplate);
    parseWithFlippedBits(data, parseAcceleratorTemplate);
}

TEST(ToolBarTemplate, SeparatorsAreCommandZero) {
    const auto bar = parseToolBarTemplate(bytesOf(IDR_MAINFRAME, RT_TOOLBAR));
    ASSERT_TRUE(bar) << bar.reason();
    EXPECT_EQ(bar->buttonWidth, 16);
    EXPECT_EQ(bar->buttonHeight, 15);
    EXPECT_EQ(bar->commands, (std::vector<WORD>{ID_FILE_NEW, ID_FILE_OPEN, 0, ID_THING_DRAW}));
}

TEST(ToolBarTemplate, DamagedOnesAreRefused) {
    const ResourceBytes data = bytesOf(IDR_MAINFRAME, RT_TOOLBAR);
    expectTruncationsRefused(data, data.size(), parseToolBarTemplate);
    parseWithFlippedBits(data, parseToolBarTemplate);
}
