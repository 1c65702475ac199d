#include "platform/afx/core/detail/PastedText.h"

#include <QClipboard>
#include <QGuiApplication>

#include <utility>

namespace tvx::afx {

namespace {

constinit const PastedText* innermost = nullptr;

} // namespace

PastedText::PastedText() : m_outer(std::exchange(innermost, this)) {}

PastedText::PastedText(const QString& text) : PastedText() {
    m_data = std::make_unique<QMimeData>();
    m_data->setText(text);
}

PastedText::~PastedText() {
    innermost = m_outer;
}

const QMimeData* pastedData() {
    return innermost && innermost->m_data ? innermost->m_data.get() : QGuiApplication::clipboard()->mimeData();
}

} // namespace tvx::afx
