#include "platform/afx/dialogs/ColorDialog.h"
#include "platform/afx/dialogs/FontDialog.h"
#include "tests/ui/afx/frames/FrameTesting.h"

#include <QColorDialog>
#include <QFontDialog>

using namespace frametest;

namespace {

/// What the user does in the dialog that comes up, before the key that ends it.
template <class Dialog>
void answer(std::function<void(Dialog&)> act, Qt::Key key = Qt::Key_Return) {
    later([act = std::move(act), key] {
        auto* dialog = qobject_cast<Dialog*>(QApplication::activeModalWidget());
        ASSERT_NE(dialog, nullptr);
        act(*dialog);
        QTest::keyClick(dialog, key);
    });
}

TEST(ColorDialog, AnswersTheColourAndKeepsTheUsersOwn) {
    CColorDialog dialog(RGB(1, 2, 3));
    dialog.SetCurrentColor(RGB(10, 20, 30));
    CColorDialog::GetSavedCustomColors()[0] = RGB(7, 8, 9);
    answer<QColorDialog>([](QColorDialog& shown) {
        EXPECT_EQ(shown.currentColor(), QColor(10, 20, 30));
        EXPECT_EQ(QColorDialog::customColor(0), QColor(7, 8, 9));
        QColorDialog::setCustomColor(1, QColor(4, 5, 6));
        shown.setCurrentColor(QColor(200, 100, 50));
    });
    EXPECT_EQ(dialog.DoModal(), IDOK);
    EXPECT_EQ(dialog.GetColor(), RGB(200, 100, 50));
    EXPECT_EQ(CColorDialog::GetSavedCustomColors()[1], RGB(4, 5, 6));

    answer<QColorDialog>([](QColorDialog& shown) { shown.setCurrentColor(Qt::green); }, Qt::Key_Escape);
    EXPECT_EQ(dialog.DoModal(), IDCANCEL);
    EXPECT_EQ(dialog.GetColor(), RGB(200, 100, 50));
}

TEST(FontDialog, AnswersTheFontInPixelsAndPoints) {
    LOGFONT first{};
    first.lfHeight = -16;
    first.lfWeight = FW_BOLD;
    CFontDialog dialog(&first);
    answer<QFontDialog>(
        [](QFontDialog& shown) {
            EXPECT_EQ(shown.currentFont().pointSize(), 12);
            EXPECT_TRUE(shown.currentFont().bold());
            EXPECT_FALSE(shown.currentFont().italic());
        },
        Qt::Key_Escape);
    EXPECT_EQ(dialog.DoModal(), IDCANCEL);
    EXPECT_TRUE(dialog.IsBold());
    CFontDialog plain;
    answer<QFontDialog>(
        [](QFontDialog& shown) { EXPECT_FALSE(shown.currentFont().bold() || shown.currentFont().italic()); });
    EXPECT_EQ(plain.DoModal(), IDOK);
    EXPECT_FALSE(plain.IsBold());

    QString family;
    answer<QFontDialog>([&](QFontDialog& shown) {
        QFont font = shown.currentFont();
        family = font.family();
        font.setPointSize(24);
        font.setStyleName(QString()); // would count more than what follows
        font.setBold(false);
        font.setItalic(true);
        font.setUnderline(true);
        font.setStrikeOut(true);
        shown.setCurrentFont(font);
    });
    EXPECT_EQ(dialog.DoModal(), IDOK);
    LOGFONT chosen{};
    dialog.GetCurrentFont(&chosen);
    EXPECT_EQ(chosen.lfHeight, -32);
    EXPECT_EQ(dialog.GetSize(), 240);
    EXPECT_EQ(dialog.GetFaceName(), family.toUtf8().constData());
    EXPECT_EQ(dialog.GetWeight(), FW_NORMAL);
    EXPECT_TRUE(dialog.IsItalic() && dialog.IsUnderline() && dialog.IsStrikeOut());
    EXPECT_EQ(dialog.GetColor(), 0U);
}

} // namespace
