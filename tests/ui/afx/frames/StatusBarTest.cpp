#include "platform/afx/gdi/detail/Geometry.h"
#include "tests/ui/afx/Tips.h"
#include "tests/ui/afx/frames/FrameTesting.h"

#include <QAccessible>
#include <QBackingStore>
#include <QElapsedTimer>

using namespace frametest;

namespace {

/// Counts the paint requests of a widget.
class Paints : public QObject {
public:
    explicit Paints(QWidget& widget) {
        widget.installEventFilter(this);
    }
    bool eventFilter(QObject*, QEvent* event) override {
        count += event->type() == QEvent::Paint ? 1 : 0;
        return false;
    }
    int count = 0;
};

class StatusBars : public FrameTest {
protected:
    void SetUp() override {
        FrameTest::SetUp();
        frame = &openNote();
        look();
    }
    void look() {
        bar = tvx::afx::peerOf(frame->status.m_hWnd);
        bar->setStyle(&style);
    }
    QList<QWidget*> panes() const {
        return bar->findChildren<QWidget*>("pane", Qt::FindDirectChildrenOnly);
    }
    CRect place(int index) const {
        CRect rect(-1, -1, -1, -1);
        frame->status.GetItemRect(index, &rect);
        return rect;
    }
    /// What assistive tools are told of a pane.
    std::string told(int index) const {
        return QAccessible::queryAccessibleInterface(panes()[index])->text(QAccessible::Name).toStdString();
    }
    /// What the screen shows of a pane.
    QImage seen(int index) const {
        const QPoint origin = panes()[index]->mapTo(bar->window(), QPoint());
        return dynamic_cast<QImage*>(bar->backingStore()->paintDevice())->copy(QRect(origin, panes()[index]->size()));
    }
    /// What it would show if the pane were painted now.
    QImage wanted(int index) const {
        return bar->grab(panes()[index]->geometry()).toImage().convertToFormat(seen(index).format());
    }
    /// Changes style bits and width of a pane.
    void shape(int index, UINT remove, UINT add, int width) {
        const UINT bits = frame->status.GetPaneStyle(index);
        frame->status.SetPaneInfo(index, frame->status.GetItemID(index), (bits & ~remove) | add, width);
    }
    NoteFrame* frame = nullptr;
    QWidget* bar = nullptr;
    QuickTips style;
};

} // namespace

TEST_F(StatusBars, PanesChangeInPlace) {
    CStatusBar& status = frame->status;
    EXPECT_EQ(status.GetCount(), 3);
    EXPECT_EQ(status.GetPaneText(1), "000 shapes");
    EXPECT_TRUE(status.SetPaneText(1, "7 shapes"));
    EXPECT_FALSE(status.SetPaneText(3, "none"));
    const auto before = panes();
    ASSERT_EQ(before.size(), 3);
    EXPECT_EQ(std::tuple(told(0), told(1), told(2)), std::tuple("Ready", "7 shapes", "")) << "Caps Lock is off";
    EXPECT_GT(place(0).Width(), place(1).Width()) << "the first pane stretches";
    EXPECT_EQ(tvx::afx::toQt(place(1)), before[1]->geometry());
    CRect none(-1, -1, -1, -1);
    EXPECT_FALSE(status.SendMessage(SB_GETRECT, 3, reinterpret_cast<LPARAM>(&none)));
    EXPECT_EQ(none, CRect(-1, -1, -1, -1));
    EXPECT_EQ(place(3), CRect(0, 0, 0, 0));

    const CRect narrow = place(1);
    shape(1, 0, 0, narrow.Width() + 40);
    EXPECT_GT(place(1).Width(), narrow.Width() + 40) << "at once";
    EXPECT_EQ(place(1).right, narrow.right);
    const QImage sunken = wanted(1);
    shape(1, 0, SBPS_STRETCH | SBPS_NOBORDERS, narrow.Width());
    EXPECT_NEAR(place(1).Width(), place(0).Width(), 1) << "they share the room";
    const QImage bare = wanted(1);
    EXPECT_NE(bare.copy(0, 0, 2, 2), sunken.copy(0, 0, 2, 2));
    shape(1, SBPS_NOBORDERS, SBPS_POPOUT, narrow.Width());
    EXPECT_NE(wanted(1).copy(0, 0, 2, 2), sunken.copy(0, 0, 2, 2));
    EXPECT_NE(wanted(1).copy(0, 0, 2, 2), bare.copy(0, 0, 2, 2));
    status.SetPaneStyle(1, SBPS_DISABLED);
    EXPECT_EQ(std::pair(told(1), status.GetPaneText(1)), std::pair(std::string(), CString("7 shapes")));
    EXPECT_EQ(panes(), before);
    EXPECT_EQ(titleOf(status), "Ready");
    const int height = place(1).Height();
    const QFont font = QApplication::font();
    QFont large = font;
    large.setPixelSize(2 * font.pixelSize());
    QApplication::setFont(large);
    settle();
    EXPECT_GT(place(1).Height(), height);
    LOGFONT asked{};
    status.GetFont()->GetLogFont(&asked);
    EXPECT_EQ(asked.lfHeight, -large.pixelSize());
    QApplication::setFont(font);
    settle();

    const UINT fewer[] = {ID_SEPARATOR, ID_INDICATOR_CAPS};
    status.SetIndicators(fewer, 2);
    EXPECT_EQ(panes(), before.first(2));
    status.SetPaneText(0, "Drawing");
    status.DestroyWindow();
    ASSERT_TRUE(status.Create(frame));
    look();
    EXPECT_EQ(std::pair(panes().size(), told(0)), std::pair(qsizetype{2}, std::string("Drawing")));
    status.SetIndicators(fewer + 1, 1);
    EXPECT_EQ(status.GetPaneStyle(0), UINT{SBPS_NOBORDERS}) << "a first pane with a text keeps its width";
}

TEST_F(StatusBars, PanesGiveWayToANarrowFrame) {
    const int least = widgetOf(*frame)->minimumSizeHint().width();
    frame->status.SetPaneText(0, std::string(500, 'm').c_str());
    shape(1, 0, 0, 3000);
    settle();
    EXPECT_EQ(widgetOf(*frame)->minimumSizeHint().width(), least);
    EXPECT_EQ(place(0).Width(), 0);
    EXPECT_GT(place(1).Width(), 100);
    EXPECT_LE(place(1).right, bar->width());
    EXPECT_EQ(place(2).Width(), 0);
    shape(1, 0, 0, 30);
    EXPECT_GT(place(0).Width(), 100);
    EXPECT_GT(place(2).Width(), 0);
}

TEST_F(StatusBars, TipsTellWhatIsCutOff) {
    const auto hover = [this] {
        rest(*widgetOf(*frame), QPoint(5, 5));
        rest(*bar, panes()[1]->geometry().center());
    };
    hover();
    EXPECT_TRUE(isTip(""));
    frame->status.SetPaneText(1, "a text that has no room in its pane");
    hover();
    EXPECT_TRUE(isTip("a text that has no room in its pane"));
    EXPECT_EQ(told(1), "a text that has no room in its pane");
    frame->status.SetPaneText(1, "7");
    hover();
    EXPECT_TRUE(isTip(""));
    QToolTip::hideText();
}

TEST_F(StatusBars, TextsAreSeenWhenTheyAreToBe) {
    QWidget& tools = *tvx::afx::peerOf(frame->tools.m_hWnd);
    const Paints paints(*panes()[1]);
    Paints others(tools);
    tools.update();
    frame->status.SetPaneText(1, "7 shapes");
    EXPECT_EQ(seen(1), wanted(1)) << "while the host works on";
    EXPECT_EQ(others.count, 0) << "nothing else is painted in between";
    settle();
    EXPECT_EQ(others.count, 1);

    const int before = paints.count;
    frame->status.SetPaneText(1, "8 shapes", FALSE);
    settle();
    EXPECT_EQ(paints.count, before);
    EXPECT_EQ(told(1), "8 shapes");
    frame->status.RedrawWindow();
    EXPECT_EQ(paints.count, before + 1) << "painted because the bar is";
    frame->status.SetPaneText(1, "9 shapes", FALSE);
    frame->status.SetPaneText(1, "9 shapes", TRUE);
    EXPECT_EQ(paints.count, before + 2);
    EXPECT_EQ(seen(1), wanted(1));
}

TEST_F(StatusBars, FastTextsAreNotAllPainted) {
    const Paints paints(*panes()[1]);
    QElapsedTimer clock;
    clock.start();
    for (int i = 0; i < 20000; ++i) {
        frame->status.SetPaneText(1, std::to_string(i).c_str());
    }
    EXPECT_GE(paints.count, 1);
    EXPECT_LE(paints.count, 16 * (clock.elapsed() / 16 + 2)) << "as many as anybody could see";
    settle();
    EXPECT_EQ(seen(1), wanted(1)) << "the last one";
    EXPECT_EQ(told(1), "19999");
}
