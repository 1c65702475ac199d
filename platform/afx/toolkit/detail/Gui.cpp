#include "platform/afx/toolkit/detail/Gui.h"

#include "platform/win/Display.h"
#include "platform/win/Module.h"
#include "platform/win/Process.h"
#include "platform/win/ResourceConstants.h"
#include "platform/win/Thread.h"
#include "platform/win/detail/LanguageTable.h"

#include <QApplication>
#include <QDir>
#include <QInputEvent>
#include <QJsonArray>
#include <QJsonObject>
#include <QLibraryInfo>
#include <QLocale>
#include <QPluginLoader>
#include <QThread>
#include <QTranslator>

#include <clocale>
#include <cstdio>
#include <cxxabi.h>
#include <utility>

namespace tvx::afx {

namespace {

/// Without a constructor, so that it is there for the floors above whichever source is initialised first.
constinit GuiHooks floorsAbove;

/// Sees every event once, with its deepest receiver, and turns it into messages. Event filters would see an ignored
/// event again at every ancestor, and exceptions could not be caught in them.
class GuiApplication : public QApplication {
public:
    GuiApplication(int& argc, char** argv)
        : QApplication(argc, argv), m_isOnX(platformName() == QLatin1String("xcb")) {}

    bool notify(QObject* receiver, QEvent* event) override {
        try {
            if (m_isOnX && event->spontaneous()) {
                noteInput(*event);
            }
            bool result = true;
            if (floorsAbove.translate(receiver, event, result)) {
                return result;
            }
            return QApplication::notify(receiver, event);
            // A thread that is ended unwinds its stack like this; the process aborts when that is not let through.
        } catch (abi::__forced_unwind&) {
            throw;
        } catch (...) {
            floorsAbove.storeException(std::current_exception());
            return true;
        }
    }

private:
    /// Keys and buttons count as the user's actions, for window managers as for the programs that are started by them.
    static void noteInput(const QEvent& event) {
        switch (event.type()) {
        case QEvent::KeyPress:
        case QEvent::KeyRelease:
        case QEvent::MouseButtonPress:
        case QEvent::MouseButtonRelease:
            setLastInputTime(static_cast<DWORD>(static_cast<const QInputEvent&>(event).timestamp()));
            break;
        default:
            break;
        }
    }

    const bool m_isOnX;
};

DWORD threadOfWindows = 0;

/// Whether the toolkit has a plug-in for a kind of display.
bool hasPlugin(const QString& kind) {
    QStringList folders{qEnvironmentVariable("QT_QPA_PLATFORM_PLUGIN_PATH")};
    for (const QString& path : QCoreApplication::libraryPaths()) {
        folders.append(path + QStringLiteral("/platforms"));
    }
    for (const QString& folder : folders) {
        for (const QFileInfo& file : QDir(folder).entryInfoList(QDir::Files)) {
            const QJsonObject description = QPluginLoader(file.filePath()).metaData();
            const QJsonArray kinds = description[QLatin1String("MetaData")][QLatin1String("Keys")].toArray();
            if (kinds.contains(QJsonValue(kind))) {
                return true;
            }
        }
    }
    return false;
}

enum class Display { Answers, Missing, NoPlugin };

/// What comes of a kind of display, as QT_QPA_PLATFORM names it: "wayland", "xcb", "offscreen:size=800x600". Without
/// plug-in or display the toolkit would end the process.
Display ask(const QString& choice) {
    const QString kind = choice.section(QLatin1Char(':'), 0, 0).toLower();
    if (kind == QLatin1String("xcb")) {
        return canOpenDisplay() ? Display::Answers : Display::Missing;
    }
    if (!kind.startsWith(QLatin1String("wayland"))) {
        return Display::Answers; // the others need none
    }
    return !canOpenWaylandDisplay() ? Display::Missing : hasPlugin(kind) ? Display::Answers : Display::NoPlugin;
}

/// Of several kinds the toolkit takes the first that it can show windows on.
Display askDisplay() {
    QString chosen = qEnvironmentVariable("QT_QPA_PLATFORM");
    if (chosen.isEmpty()) {
        chosen = QStringLiteral("wayland;xcb");
    }
    Display result = Display::Missing;
    for (const QString& choice : chosen.split(QLatin1Char(';'), Qt::SkipEmptyParts)) {
        const Display answer = ask(choice);
        if (answer == Display::Answers) {
            return answer;
        }
        result = answer == Display::NoPlugin ? answer : result;
    }
    return result;
}

Display display() {
    static const Display answer = askDisplay();
    return answer;
}

/// The toolkit's own texts (menus of text fields, lists of files) in the user's language, where they are installed.
void translateToolkit() {
    const LCID locale = GetUserDefaultLCID();
    const tvx::detail::Language* language = tvx::detail::languageOf(locale);
    if (!language || PRIMARYLANGID(LANGIDFROMLCID(locale)) == LANG_ENGLISH) {
        return;
    }
    auto* translator = new QTranslator(QCoreApplication::instance());
    const QString folder = QLibraryInfo::path(QLibraryInfo::TranslationsPath);
    if (translator->load(QLocale(QLatin1String(language->name)), QStringLiteral("qtbase"), QStringLiteral("_"),
                         folder)) {
        QCoreApplication::installTranslator(translator);
    }
}

void makeApplication() {
    // The program's name only: the toolkit would take options of its own out of the host's command line.
    static int argc = 1;
    static std::string name = moduleFileName(nullptr);
    static char* argv[] = {name.data(), nullptr};
    // A window of the system for one widget, as dialogs have that stand over a frame, makes none of its relatives'.
    QCoreApplication::setAttribute(Qt::AA_DontCreateNativeWidgetSiblings);
    new GuiApplication(argc, argv); // the toolkit keeps it as qApp, to the end of the process
    threadOfWindows = GetCurrentThreadId();
    // The main window's end is the application's end, whatever other windows are or are not shown.
    QApplication::setQuitOnLastWindowClosed(false);
    translateToolkit();
    // The toolkit has taken the process's locale from the environment; numbers keep their point.
    std::setlocale(LC_NUMERIC, "C");
    floorsAbove.started();
}

} // namespace

void setGuiHooks(const GuiHooks& hooks) {
    floorsAbove = hooks;
}

DWORD guiThread() {
    return threadOfWindows;
}

bool hasDisplay() {
    return display() == Display::Answers;
}

namespace {

bool displayMissed = false;

} // namespace

void tellMissingDisplay() {
    if (!std::exchange(displayMissed, true)) {
        std::fputs(display() == Display::NoPlugin
                       ? "The toolkit's plug-in for this display is not installed: for Wayland it is in the package "
                         "qt6-wayland. An X display can be named with DISPLAY instead.\n"
                       : "There is no display to show windows on: set DISPLAY to one that answers.\n",
                   stderr);
    }
}

bool wasDisplayMissed() {
    return displayMissed;
}

bool ensureGui() {
    if (!QCoreApplication::instance()) {
        if (!hasDisplay()) {
            return false;
        }
        makeApplication();
    }
    return true;
}

} // namespace tvx::afx
