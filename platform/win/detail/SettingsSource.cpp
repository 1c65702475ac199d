#include "platform/win/detail/SettingsSource.h"

#include "platform/win/detail/DesktopView.h"

namespace tvx::registry {

namespace {

/// The store of a hive.
class StoreSource : public Source {
public:
    explicit StoreSource(Hive hive) : m_hive(hive) {}

    DWORD findKey(const KeyPath& key) override {
        return withStore(m_hive, [&](Store& store) { return store.findKey(key); });
    }
    DWORD readValue(const KeyPath& key, std::string_view name, std::shared_ptr<const Value>& value) override {
        return withStore(m_hive, [&](Store& store) { return store.readValue(key, name, value); });
    }
    DWORD keyAt(const KeyPath& key, DWORD index, Cursor& cursor, std::string& name) override {
        return withStore(m_hive, [&](Store& store) { return store.keyAt(key, index, cursor, name); });
    }
    DWORD valueAt(const KeyPath& key, DWORD index, Cursor& cursor, Value& value) override {
        return withStore(m_hive, [&](Store& store) { return store.valueAt(key, index, cursor, value); });
    }

private:
    const Hive m_hive;
};

// Settings may be read at any time, also while the process ends: what stands here is never taken down.

Source* storeOf(Hive hive) {
    static auto* const user = new StoreSource(Hive::User);
    static auto* const machine = new StoreSource(Hive::Machine);
    return hive == Hive::User ? user : machine;
}

Source* desktopView() {
    static auto* const view = new DesktopView;
    return view;
}

} // namespace

const Chain& userChain() {
    static const auto* const chain = new Chain{Hive::User, {storeOf(Hive::User)}};
    return *chain;
}

const Chain& classesChain() {
    static const auto* const chain =
        new Chain{Hive::User, {storeOf(Hive::User), storeOf(Hive::Machine), desktopView()}};
    return *chain;
}

const Chain& machineChain() {
    static const auto* const chain = new Chain{Hive::Machine, {storeOf(Hive::Machine), desktopView()}};
    return *chain;
}

} // namespace tvx::registry
