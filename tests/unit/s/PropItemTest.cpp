// Items of property sheets: their page, what they tell of it, and what they keep. No window is made.
#include "s/PropItem.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

namespace {

int pagesMade = 0;
int pagesDeleted = 0;
bool refuses = false;
std::vector<std::pair<CWnd*, int>> told;

class Page : public CWnd {
public:
    ~Page() override {
        ++pagesDeleted;
    }
};

CWnd* makePage(Gui_PropItem*, Gui_PropSheet* sheet) {
    EXPECT_EQ(sheet, nullptr);
    if (refuses) {
        return nullptr;
    }
    ++pagesMade;
    return new Page;
}

void notifyPage(Gui_PropItem*, CWnd* page, Gui_PropItem::Notification what) {
    told.emplace_back(page, what);
}

class PropItem : public testing::Test {
protected:
    PropItem() {
        pagesMade = pagesDeleted = 0;
        refuses = false;
        told.clear();
    }
};

} // namespace

TEST_F(PropItem, MakesItsPageOnceWithTheFirstNotificationAndDeletesIt) {
    {
        Gui_PropItem item("Grid", makePage, notifyPage, Gui_PropItem::StateCollapsed);
        EXPECT_EQ(item.GetCachedPage(), nullptr);
        refuses = true;
        EXPECT_EQ(item.GetPage(), nullptr);
        refuses = false;
        item.DeactivatePage();
        CWnd* const page = item.GetCachedPage();
        ASSERT_NE(page, nullptr);
        item.ActivatePage();
        item.ReactivatePage();
        item.ApplyPageChanges();
        item.ShowHelp();
        item.SetFocusFirst();
        item.SetFocusLast();
        EXPECT_EQ(item.GetPage(), page);
        EXPECT_EQ(pagesMade, 1);
        using Told = std::vector<std::pair<CWnd*, int>>;
        EXPECT_EQ(told, (Told{{page, 2}, {page, 0}, {page, 1}, {page, 3}, {page, 4}, {page, 5}, {page, 6}}));
        Page other;
        item.SetCachedPage(&other);
        EXPECT_EQ(item.GetPage(), &other);
        EXPECT_EQ(pagesDeleted, 0) << "the page before is the caller's";
        item.SetCachedPage(page);
        const std::unique_ptr<CWnd> another(item.CreatePage());
        EXPECT_NE(another.get(), page) << "which keeps nothing";
    }
    EXPECT_EQ(pagesDeleted, 3) << "the test's own two and the item's";
}

TEST_F(PropItem, TellsOfNoPageWithoutAFunctionThatMakesOne) {
    Gui_PropItem item("Category", nullptr, notifyPage, Gui_PropItem::StateDefault);
    item.ActivatePage();
    EXPECT_EQ(item.GetPage(), nullptr);
    ASSERT_EQ(told.size(), 1u);
    EXPECT_EQ(told[0].first, nullptr);
    item.SetNotifyPageFunction(nullptr);
    item.SetCreatePageFunction(makePage);
    item.ActivatePage();
    EXPECT_EQ(told.size(), 1u);
    EXPECT_NE(item.GetCachedPage(), nullptr);
    EXPECT_EQ(item.GetCreatePageFunction(), makePage);
    EXPECT_EQ(item.GetNotifyPageFunction(), nullptr);
}

TEST_F(PropItem, GoesThroughWhatAHostOverrides) {
    class Shared : public Gui_PropItem {
    public:
        Shared(Gui_PropItem& owner) : Gui_PropItem("Shared", nullptr, notifyPage, StateDefault), m_owner(owner) {}
        CWnd* GetPage() override {
            return m_owner.GetPage();
        }

    private:
        Gui_PropItem& m_owner;
    };
    class Own : public Gui_PropItem {
    public:
        Own() : Gui_PropItem("Own", nullptr, nullptr, StateDefault) {}
        CWnd* CreatePage() override {
            return new Page;
        }
    };
    Own own;
    Shared shared(own);
    shared.ShowHelp();
    ASSERT_EQ(told.size(), 1u);
    EXPECT_EQ(told[0].first, own.GetCachedPage());
    EXPECT_NE(told[0].first, nullptr);
    EXPECT_EQ(shared.GetCachedPage(), nullptr);
}
