#include "platform/afx/core/detail/KeyLayout.h"

#include "platform/afx/core/detail/KeyTable.h"
#include "platform/win/ResourceConstants.h"

#include <QAbstractNativeEventFilter>
#include <QGuiApplication>

#include <algorithm>
#include <array>
#include <optional>
#include <utility>

namespace tvx::afx {

namespace {

/// Key codes are the codes of the kernel plus this, and those of the main block are scan codes.
constexpr unsigned firstKeyCode = 8;
constexpr unsigned lastMainKey = firstKeyCode + 0x58;
/// Keys that only some keyboards have: beside the right Shift key, and left of Backspace.
constexpr unsigned extraKeys[] = {97, 132};
constexpr unsigned decimalKey = 91;

/// These are on the same key as their sign on every layout.
constexpr std::pair<int, char32_t> signKeys[] = {
    {VK_OEM_PLUS, U'+'}, {VK_OEM_COMMA, U','}, {VK_OEM_MINUS, U'-'}, {VK_OEM_PERIOD, U'.'}};
/// These where one of their signs is typed without Shift.
constexpr std::pair<int, const char*> otherSignKeys[] = {{VK_OEM_1, ";:"}, {VK_OEM_2, "/?"},  {VK_OEM_3, "`~"},
                                                         {VK_OEM_4, "[{"}, {VK_OEM_5, "\\|"}, {VK_OEM_6, "]}"},
                                                         {VK_OEM_7, "'\""}};
/// What keys get whose own virtual key another key has.
constexpr int spareKeys[] = {VK_OEM_1, VK_OEM_2,   VK_OEM_3,    VK_OEM_4,     VK_OEM_5,     VK_OEM_6,     VK_OEM_7,
                             VK_OEM_8, VK_OEM_102, VK_OEM_PLUS, VK_OEM_COMMA, VK_OEM_MINUS, VK_OEM_PERIOD};

bool isDigit(char32_t sign) {
    return sign >= U'0' && sign <= U'9';
}

bool isLatin(char32_t sign) {
    return sign >= U'a' && sign <= U'z';
}

} // namespace

int characterKeyAt(unsigned keyCode) {
    if (keyCode <= firstKeyCode || keyCode > lastMainKey) {
        return 0;
    }
    const int key = virtualKeyAt(static_cast<int>(keyCode - firstKeyCode));
    return isCharacterKey(key) && key != VK_SPACE ? key : 0;
}

KeyLayout::KeyLayout(const std::vector<KeySigns>& signs) {
    for (unsigned code = 0; code < signs.size(); ++code) {
        const bool isExtra = std::ranges::find(extraKeys, code) != std::end(extraKeys);
        if (signs[code].plain != 0 && (isExtra || characterKeyAt(code) != 0)) {
            m_keys.push_back({code, signs[code], 0});
        }
    }
    const auto letters = std::ranges::count_if(m_keys, [](const Key& key) { return isLatin(key.signs.plain); });
    if (letters > 20) {
        placeLetters();
        placeSigns();
    }
    placeOthers();
    if (signs.size() > decimalKey) {
        // Its sign is that with NumLock.
        m_keys.push_back({decimalKey, {signs[decimalKey].shifted, 0}, VK_DECIMAL});
    }
}

bool KeyLayout::isGiven(int virtualKey) const {
    return std::ranges::find(m_keys, virtualKey, &Key::virtualKey) != m_keys.end();
}

/// Gives a virtual key to the first key with this sign that has none.
void KeyLayout::give(int virtualKey, char32_t KeySigns::* which, char32_t sign) {
    const auto isMeant = [&](const Key& key) { return key.virtualKey == 0 && key.signs.*which == sign; };
    const auto found = std::ranges::find_if(m_keys, isMeant);
    if (found != m_keys.end() && !isGiven(virtualKey)) {
        found->virtualKey = virtualKey;
    }
}

void KeyLayout::placeLetters() {
    for (Key& key : m_keys) {
        const int place = characterKeyAt(key.keyCode);
        int meant = 0;
        if (isLatin(key.signs.plain)) {
            meant = static_cast<int>(key.signs.plain - U'a') + 'A';
        } else if (isDigit(key.signs.plain)) {
            meant = static_cast<int>(key.signs.plain);
        } else if (isDigit(static_cast<char32_t>(place))) {
            meant = isDigit(key.signs.shifted) ? static_cast<int>(key.signs.shifted) : place;
        }
        key.virtualKey = isGiven(meant) ? 0 : meant;
    }
}

void KeyLayout::placeSigns() {
    for (const auto& [virtualKey, sign] : signKeys) {
        give(virtualKey, &KeySigns::plain, sign);
        give(virtualKey, &KeySigns::shifted, sign);
    }
    for (const auto& [virtualKey, signs] : otherSignKeys) {
        give(virtualKey, &KeySigns::plain, static_cast<char32_t>(signs[0]));
        give(virtualKey, &KeySigns::plain, static_cast<char32_t>(signs[1]));
    }
}

void KeyLayout::placeOthers() {
    for (Key& key : m_keys) {
        const int place = characterKeyAt(key.keyCode);
        if (key.virtualKey == 0 && place != 0 && !isGiven(place)) {
            key.virtualKey = place;
        }
    }
    for (Key& key : m_keys) {
        const auto* spare = std::ranges::find_if(spareKeys, [this](int spare) { return !isGiven(spare); });
        if (key.virtualKey == 0 && spare != std::end(spareKeys)) {
            key.virtualKey = *spare;
        }
    }
}

int KeyLayout::virtualKey(unsigned keyCode) const {
    const auto found = std::ranges::find(m_keys, keyCode, &Key::keyCode);
    return found != m_keys.end() && keyCode != decimalKey ? found->virtualKey : 0;
}

char32_t KeyLayout::sign(int virtualKey) const {
    const auto found = std::ranges::find(m_keys, virtualKey, &Key::virtualKey);
    return found != m_keys.end() ? found->signs.plain : 0;
}

// --- the user's ---

namespace {

using Layouts = std::array<std::optional<KeyLayout>, 2>;

/// The layouts that the user switches between; empty until they are asked for.
Layouts& knownLayouts() {
    static auto* layouts = new Layouts;
    return *layouts;
}
quint32 presentModifiers = 0;

/// Forgets the layouts when the display says that there are others.
class LayoutWatch : public QAbstractNativeEventFilter {
public:
    bool nativeEventFilter(const QByteArray& type, void* message, qintptr*) override {
        if (type == "xcb_generic_event_t" && isKeyboardChange(message)) {
            knownLayouts() = {};
        }
        return false;
    }
};

void readLayouts() {
    [[maybe_unused]] static const bool watched = [] {
        QCoreApplication::instance()->installNativeEventFilter(new LayoutWatch); // as long as the application lives
        return true;
    }();
    const auto all = keyboardSigns();
    for (std::size_t layout = 0; layout < knownLayouts().size(); ++layout) {
        std::vector<KeySigns> signs;
        std::ranges::transform(all, std::back_inserter(signs), [layout](const auto& key) { return key[layout]; });
        knownLayouts()[layout].emplace(signs);
    }
}

} // namespace

const KeyLayout* layoutOf(quint32 nativeModifiers) {
    presentModifiers = nativeModifiers;
    const quint32 number = nativeModifiers >> 13 & 3U; // the display's place for it
    if (number >= knownLayouts().size() || QGuiApplication::platformName() != QLatin1String("xcb")) {
        return nullptr;
    }
    if (!knownLayouts()[number]) {
        readLayouts();
    }
    return &*knownLayouts()[number];
}

const KeyLayout* presentLayout() {
    return layoutOf(presentModifiers);
}

} // namespace tvx::afx
