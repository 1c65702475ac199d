#include "platform/afx/core/Clipboard.h"

#include "platform/afx/core/Message.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/PastedText.h"
#include "platform/afx/toolkit/detail/Gui.h"

#include <QApplication>
#include <QClipboard>
#include <QMimeData>

#include <cstring>
#include <map>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

using namespace tvx::afx;

namespace {

using Block = std::vector<char>;

/// The blocks of memory by the address of their bytes, which is their handle.
std::unordered_map<void*, Block>& blocks() {
    static auto* all = new std::unordered_map<void*, Block>;
    return *all;
}

HGLOBAL addBlock(Block block) {
    block.reserve(1); // an empty block has an address too
    void* address = block.data();
    blocks()[address] = std::move(block);
    return address;
}

struct Clipboard {
    bool open = false;
    HWND opener = nullptr;
    bool changed = false;
    std::map<UINT, HANDLE> own;        ///< What was set since it was emptied.
    std::vector<HANDLE> borrowed;      ///< What GetClipboardData handed out.
    std::map<UINT, std::string> names; ///< Registered formats.
};

Clipboard& clipboard() {
    static auto* instance = new Clipboard;
    return *instance;
}

QString mimeTypeOf(UINT format) {
    const auto found = clipboard().names.find(format);
    // Names of formats may hold blanks and more that a MIME type may not.
    return found == clipboard().names.end()
               ? QString()
               : QStringLiteral("application/x-tvx-") +
                     QString::fromLatin1(QByteArray::fromStdString(found->second).toPercentEncoding());
}

QByteArray bytesOf(HANDLE handle) {
    const auto found = blocks().find(handle);
    return found != blocks().end() ? QByteArray(found->second.data(), static_cast<qsizetype>(found->second.size()))
                                   : QByteArray();
}

/// Gives what was set to the desktop's clipboard.
void publish(Clipboard& state) {
    auto data = std::make_unique<QMimeData>();
    for (const auto& [format, handle] : state.own) {
        const QByteArray bytes = bytesOf(handle);
        if (format == CF_TEXT) {
            data->setText(QString::fromUtf8(
                bytes.constData(),
                static_cast<qsizetype>(qstrnlen(bytes.constData(), static_cast<size_t>(bytes.size())))));
        } else if (const QString type = mimeTypeOf(format); !type.isEmpty()) {
            data->setData(type, bytes);
        }
    }
    guarded([&] { QApplication::clipboard()->setMimeData(data.release()); });
}

void release(Clipboard& state) {
    for (const HANDLE handle : state.borrowed) {
        GlobalFree(handle);
    }
    state.borrowed.clear();
}

} // namespace

BOOL OpenClipboard(HWND window) {
    Clipboard& state = clipboard();
    if (!ensureGui() || (state.open && state.opener != window)) {
        return FALSE;
    }
    state.open = true;
    state.opener = window;
    return TRUE;
}

BOOL CloseClipboard() {
    Clipboard& state = clipboard();
    if (!state.open) {
        return FALSE;
    }
    // All formats at once: what is given to the toolkit replaces everything that it was given before.
    if (std::exchange(state.changed, false)) {
        publish(state);
    }
    release(state);
    state.open = false;
    state.opener = nullptr;
    return TRUE;
}

BOOL EmptyClipboard() {
    Clipboard& state = clipboard();
    if (!state.open) {
        return FALSE;
    }
    for (const auto& [format, handle] : state.own) {
        GlobalFree(handle);
    }
    state.own.clear();
    state.changed = true;
    return TRUE;
}

HANDLE SetClipboardData(UINT format, HANDLE block) {
    Clipboard& state = clipboard();
    if (!state.open || !blocks().contains(block)) {
        return nullptr;
    }
    HANDLE& place = state.own[format];
    if (place && place != block) {
        GlobalFree(place);
    }
    place = block;
    state.changed = true;
    return block;
}

HANDLE GetClipboardData(UINT format) {
    Clipboard& state = clipboard();
    if (!state.open) {
        return nullptr;
    }
    // What was set in this use is not with the desktop yet.
    if (state.changed) {
        const auto found = state.own.find(format);
        return found != state.own.end() ? found->second : nullptr;
    }
    if (!IsClipboardFormatAvailable(format)) {
        return nullptr;
    }
    const QMimeData* data = pastedData();
    QByteArray bytes = format == CF_TEXT ? data->text().toUtf8() : data->data(mimeTypeOf(format));
    Block block(bytes.begin(), bytes.end());
    if (format == CF_TEXT) {
        block.push_back('\0');
    }
    state.borrowed.push_back(addBlock(std::move(block)));
    return state.borrowed.back();
}

BOOL IsClipboardFormatAvailable(UINT format) {
    if (!ensureGui()) {
        return FALSE;
    }
    const Clipboard& state = clipboard();
    if (state.changed) {
        return state.own.contains(format) ? TRUE : FALSE;
    }
    const QMimeData* data = pastedData();
    if (!data) {
        return FALSE;
    }
    const QString type = mimeTypeOf(format);
    return format == CF_TEXT ? data->hasText() : !type.isEmpty() && data->hasFormat(type);
}

UINT RegisterClipboardFormatA(LPCSTR name) {
    const UINT format = RegisterWindowMessageA(name);
    if (format != 0) {
        clipboard().names[format] = name;
    }
    return format;
}

// --- memory ---

HGLOBAL GlobalAlloc(UINT, std::size_t bytes) {
    try {
        Block block;
        block.reserve(bytes + 1);
        block.resize(bytes);
        return addBlock(std::move(block));
    } catch (const std::exception&) {
        return nullptr;
    }
}

HGLOBAL GlobalReAlloc(HGLOBAL handle, std::size_t bytes, UINT flags) {
    const auto found = blocks().find(handle);
    const HGLOBAL fresh = found != blocks().end() ? GlobalAlloc(flags, bytes) : nullptr;
    if (!fresh) {
        return nullptr;
    }
    std::memcpy(fresh, handle, std::min(bytes, found->second.size()));
    GlobalFree(handle);
    return fresh;
}

LPVOID GlobalLock(HGLOBAL block) {
    return blocks().contains(block) ? block : nullptr;
}

BOOL GlobalUnlock(HGLOBAL block) {
    return blocks().contains(block) ? TRUE : FALSE;
}

std::size_t GlobalSize(HGLOBAL block) {
    const auto found = blocks().find(block);
    return found != blocks().end() ? found->second.size() : 0;
}

HGLOBAL GlobalFree(HGLOBAL block) {
    return blocks().erase(block) != 0 ? nullptr : block;
}
