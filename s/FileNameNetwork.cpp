#include "s/FileNameNetwork.h"

#include "platform/base/Text.h"
#include "platform/win/Error.h"
#include "platform/win/Network.h"

#include <algorithm>
#include <functional>
#include <span>
#include <string_view>
#include <vector>

namespace {

using Wanted = std::function<bool(const NETRESOURCEA&)>;

char upper(char letter) {
    return letter >= 'a' && letter <= 'z' ? static_cast<char>(letter - 'a' + 'A') : letter;
}

/// The connections that the system tells, one after the other.
class Connections {
public:
    Connections() {
        if (WNetOpenEnumA(RESOURCE_CONNECTED, RESOURCETYPE_DISK, 0, nullptr, &m_handle) != ERROR_SUCCESS) {
            m_handle = nullptr;
        }
    }
    ~Connections() {
        if (m_handle) {
            WNetCloseEnum(m_handle);
        }
    }
    Connections(const Connections&) = delete;
    Connections& operator=(const Connections&) = delete;

    /// The next ones, as many as fit; none at the end. Valid until the next call.
    std::span<const NETRESOURCEA> next() {
        auto size = static_cast<DWORD>(m_buffer.size());
        DWORD count = 0;
        DWORD error = read(count, size);
        if (error == ERROR_MORE_DATA && size > m_buffer.size()) {
            m_buffer.resize(size);
            error = read(count, size);
        }
        if (error != ERROR_SUCCESS) {
            return {};
        }
        return {reinterpret_cast<const NETRESOURCEA*>(m_buffer.data()), count};
    }

private:
    DWORD read(DWORD& count, DWORD& size) {
        constexpr DWORD asManyAsFit = 0xFFFFFFFF;
        count = asManyAsFit;
        return m_handle ? WNetEnumResourceA(m_handle, &count, m_buffer.data(), &size) : ERROR_INVALID_HANDLE;
    }

    HANDLE m_handle = nullptr;
    std::vector<char> m_buffer = std::vector<char>(1600);
};

/// The first connection that is wanted, as what `result` makes of it; empty when there is none.
CString findConnection(const Wanted& isWanted, const std::function<CString(const NETRESOURCEA&)>& result) {
    CString found;
    tvx::allocating([&] {
        Connections connections;
        for (auto some = connections.next(); !some.empty(); some = connections.next()) {
            if (const auto at = std::ranges::find_if(some, isWanted); at != some.end()) {
                found = result(*at);
                return;
            }
        }
    });
    return found;
}

} // namespace

CString ShareOfDrive(char letter) {
    return findConnection(
        [letter](const NETRESOURCEA& connection) {
            return connection.lpLocalName && connection.lpRemoteName && upper(*connection.lpLocalName) == upper(letter);
        },
        [](const NETRESOURCEA& connection) { return CString(connection.lpRemoteName); });
}

CString DriveOfShare(const CString& share) {
    return findConnection(
        [&share](const NETRESOURCEA& connection) {
            return connection.lpLocalName && connection.lpRemoteName &&
                   tvx::text::equalNoCase(connection.lpRemoteName, share.View());
        },
        [](const NETRESOURCEA& connection) { return CString(upper(*connection.lpLocalName)) + ':'; });
}
