#include "samples/board/Options.h"

#include "samples/family/FamilyOptions.h"
#include "tests/unit/s/StoreTest.h"
#include "tests/unit/s/TestApp.h"

#include <gtest/gtest.h>

namespace {

/// The choices of an application whose settings are its own.
class BoardOptions : public StoreTest {
protected:
    void SetUp() override {
        StoreTest::SetUp();
        theApp.SetRegistryKey("Maker");
    }
    static void store(const char* entry, int value) {
        theApp.WriteProfileInt("Preferences", entry, value);
    }
};

TEST_F(BoardOptions, AreThoseThatTheBoardComesWithWhereTheStoredOnesCannotBe) {
    const Options own;
    for (const int wrong : {-1, 0x1000000}) {
        for (const char* entry : {"GridShown", "GridDistance", "Paper", "LineWidth", "TextSize"}) {
            store(entry, wrong);
        }
        const Options read = Options::Read();
        EXPECT_EQ(read.gridShown, own.gridShown) << wrong;
        EXPECT_EQ(read.gridDistance, own.gridDistance) << wrong;
        EXPECT_EQ(read.paper, own.paper) << wrong;
        EXPECT_EQ(read.lineWidth, own.lineWidth) << wrong;
        EXPECT_EQ(read.textSize, own.textSize) << wrong;
    }
    theApp.WriteProfileString("Preferences", "GridDistance", "wide");
    theApp.WriteProfileString("Preferences", "TextFont", "");
    EXPECT_EQ(Options::Read().gridDistance, own.gridDistance);
    EXPECT_EQ(Options::Read().textFont, own.textFont);
    store("GridDistance", 0);
    store("Paper", 0xFFFFFF);
    store("LineWidth", 20);
    EXPECT_EQ(Options::Read().gridDistance, 0);
    EXPECT_EQ(Options::Read().paper, COLORREF{0xFFFFFF});
    EXPECT_EQ(Options::Read().lineWidth, 20);
}

TEST_F(BoardOptions, OnlyWhatWasChangedIsStored) {
    const Options before = Options::Read();
    Options options = before;
    options.textItalic = TRUE;
    options.textFont = "Serif";
    store("GridDistance", 50); // by another board
    options.Write(before);
    const Options read = Options::Read();
    EXPECT_EQ(read.gridDistance, 50);
    EXPECT_TRUE(read.textItalic);
    EXPECT_EQ(read.textFont, "Serif");
}

TEST_F(BoardOptions, WhatTheEnvironmentDecidesIsNotStored) {
    setenv("TVX_GUI_HELP_WEB_LOCATION", "http://example.invalid/", 1);
    const FamilyOptions before = FamilyOptions::Read();
    FamilyOptions options = before;
    options.documentFolder = "/drawings";
    options.Write(before);
    EXPECT_EQ(FamilyOptions::Read().webLocation, "http://example.invalid/");
    unsetenv("TVX_GUI_HELP_WEB_LOCATION");
    EXPECT_EQ(FamilyOptions::Read().webLocation, "");
    EXPECT_EQ(FamilyOptions::Read().documentFolder, "/drawings");
}

} // namespace
