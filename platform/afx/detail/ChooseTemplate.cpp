#include "platform/afx/detail/ChooseTemplate.h"

#include "platform/afx/App.h"
#include "platform/afx/detail/Gui.h"
#include "platform/afx/detail/Loop.h"
#include "platform/afx/detail/Window.h"

#include <QDialog>
#include <QDialogButtonBox>
#include <QListWidget>
#include <QVBoxLayout>

namespace tvx::afx {

namespace {

/// The names in a list, with OK and Cancel.
class Chooser : public QDialog {
public:
    Chooser(QWidget* over, const std::vector<CString>& names) : QDialog(over) {
        setWindowTitle(QStringLiteral("New"));
        auto* layout = new QVBoxLayout(this);
        m_list = new QListWidget(this);
        for (const CString& name : names) {
            m_list->addItem(toQt(name));
        }
        m_list->setCurrentRow(0);
        auto* buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
        layout->addWidget(m_list);
        layout->addWidget(buttons);
        connect(buttons, &QDialogButtonBox::accepted, this, [this] { m_loop.end(m_list->currentRow()); });
        connect(buttons, &QDialogButtonBox::rejected, this, [this] { m_loop.end(-1); });
        connect(m_list, &QListWidget::itemDoubleClicked, this, [this] { m_loop.end(m_list->currentRow()); });
        setWindowModality(Qt::ApplicationModal);
    }

    void accept() override {
        m_loop.end(m_list->currentRow());
    }
    void reject() override {
        m_loop.end(-1);
    }
    int choose() {
        guarded([this] {
            show();
            m_list->setFocus();
        });
        const int chosen = m_loop.run();
        guarded([this] { hide(); });
        return chosen;
    }

private:
    QListWidget* m_list;
    ModalLoop m_loop;
};

} // namespace

int chooseName(const std::vector<CString>& names) {
    if (!ensureGui()) {
        return -1;
    }
    const CWnd* main = AfxGetMainWnd();
    const Window* window = main != nullptr ? main->GetState() : nullptr;
    Chooser chooser(window != nullptr ? window->widget() : nullptr, names);
    return chooser.choose();
}

} // namespace tvx::afx
