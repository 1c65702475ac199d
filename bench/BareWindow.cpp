// The least that a toolkit program does to show what the board sample shows when it starts: a main window with the same
// menus, tool bar and status bar, and an empty drawing in a window of its own. The peer of StartBench.

#include <QAction>
#include <QApplication>
#include <QLabel>
#include <QMainWindow>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenuBar>
#include <QPainter>
#include <QStatusBar>
#include <QToolBar>

#include <array>

namespace {

struct MenuTexts {
    const char* title;
    std::array<const char*, 8> items;
};

// The menus of a drawing window; "-" is a separator.
constexpr std::array menus = {
    MenuTexts{"&File", {"&New", "&Open...", "&Close", "-", "&Save", "Save &As...", "-", "E&xit"}},
    MenuTexts{"&Edit", {"&Undo", "&Redo", "-", "&Delete", "&Text...", "-", "Bring to &Front", "Send to &Back"}},
    MenuTexts{"&View", {"&Toolbar", "&Status Bar"}},
    MenuTexts{"&Draw", {"&Select", "&Rectangle", "&Ellipse", "&Line", "&Text", "-", "&Colour", "&Fill"}},
    MenuTexts{"&Window", {"&New Window", "&Cascade", "&Tile", "&Arrange Icons"}},
    MenuTexts{"&Help", {"&About Board..."}}};
constexpr int buttonCount = 12;
constexpr int buttonWidth = 16;
constexpr int buttonHeight = 15;

class Drawing : public QWidget {
protected:
    void paintEvent(QPaintEvent*) override {
        QPainter(this).fillRect(rect(), Qt::white);
    }
};

void addMenus(QMainWindow& window) {
    for (const MenuTexts& texts : menus) {
        QMenu* menu = window.menuBar()->addMenu(texts.title);
        for (const char* item : texts.items) {
            if (item && *item == '-') {
                menu->addSeparator();
            } else if (item) {
                menu->addAction(item);
            }
        }
    }
}

void addToolBar(QMainWindow& window, const QString& pictureFile) {
    const QPixmap picture(pictureFile);
    QToolBar* bar = window.addToolBar("Toolbar");
    bar->setIconSize({buttonWidth, buttonHeight});
    for (int i = 0; i < buttonCount; ++i) {
        bar->addAction(QIcon(picture.copy(i * buttonWidth, 0, buttonWidth, buttonHeight)), {});
    }
}

} // namespace

int main(int argc, char** argv) {
    QApplication application(argc, argv);
    QMainWindow window;
    window.setWindowTitle("Bare window");
    addMenus(window);
    addToolBar(window, argc > 1 ? argv[1] : "");
    window.statusBar()->showMessage("Ready");
    window.statusBar()->addPermanentWidget(new QLabel("0, 0"));
    auto* area = new QMdiArea;
    window.setCentralWidget(area);
    QMdiSubWindow* child = area->addSubWindow(new Drawing);
    child->resize(600, 400);
    window.resize(1000, 700);
    window.show();
    child->show();
    return QApplication::exec();
}
