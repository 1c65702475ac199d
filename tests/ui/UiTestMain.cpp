#include "platform/afx/toolkit/detail/Gui.h"

#include <QAccessible>
#include <QApplication>
#include <QFont>

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>

namespace {

/// File dialogs leave the program in the chosen file's folder, which is gone with the test.
class StartFolder : public testing::EmptyTestEventListener {
    void OnTestEnd(const testing::TestInfo&) override {
        std::filesystem::current_path(m_folder);
    }
    const std::filesystem::path m_folder = std::filesystem::current_path();
};

} // namespace

/// Pixels and metrics are compared, so display, style and font are the same on every machine.
int main(int argc, char** argv) {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    testing::InitGoogleTest(&argc, argv);
    testing::UnitTest::GetInstance()->listeners().Append(new StartFolder);
    if (!tvx::afx::ensureGui()) {
        return 1;
    }
    QAccessible::setActive(true); // as an assistive tool does: what it is told lives beside the windows
    QApplication::setStyle(QStringLiteral("Fusion"));
    QFont font(QStringLiteral("DejaVu Sans Condensed"));
    font.setPixelSize(11);
    font.setHintingPreference(QFont::PreferFullHinting);
    font.setKerning(false);
    QApplication::setFont(font);
    return RUN_ALL_TESTS();
}
