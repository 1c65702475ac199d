#include "platform/win/detail/RegistryImage.h"

#include <algorithm>
#include <optional>

namespace tvx::registry {

namespace {

using Number = Image::Number;

constexpr std::size_t fileHeadSize = 100;
constexpr unsigned innerIndex = 2;
constexpr unsigned innerTable = 5;
constexpr unsigned leafIndex = 10;
constexpr unsigned leafTable = 13;

bool isInner(unsigned kind) {
    return kind == innerIndex || kind == innerTable;
}

/// A number with the highest byte first; 0 where the bytes end.
std::uint64_t numberAt(std::string_view bytes, std::size_t at, std::size_t size) {
    std::uint64_t number = 0;
    for (std::size_t i = at; i < at + size && i < bytes.size(); ++i) {
        number = number << 8 | static_cast<std::uint8_t>(bytes[i]);
    }
    return at + size <= bytes.size() ? number : 0;
}

/// Takes a number of one to nine bytes off the front; nothing where the bytes end.
std::optional<std::uint64_t> takeVariable(std::string_view& bytes) {
    std::uint64_t number = 0;
    for (std::size_t i = 0; i < bytes.size() && i < 9; ++i) {
        const auto byte = static_cast<std::uint8_t>(bytes[i]);
        number = i == 8 ? number << 8 | byte : number << 7 | (byte & 0x7Fu);
        if (byte < 0x80 || i == 8) {
            bytes.remove_prefix(i + 1);
            return number;
        }
    }
    return std::nullopt;
}

std::size_t columnSize(std::uint64_t kind) {
    constexpr std::size_t sizes[] = {0, 1, 2, 3, 4, 6, 8, 8, 0, 0, 0, 0};
    return kind < std::size(sizes) ? sizes[kind] : static_cast<std::size_t>((kind - 12) / 2);
}

Image::Column columnOf(std::uint64_t kind, std::string_view bytes) {
    if (kind == 8 || kind == 9) {
        return static_cast<std::int64_t>(kind - 8);
    }
    if (kind >= 1 && kind <= 6) {
        const unsigned unused = 64 - 8 * static_cast<unsigned>(bytes.size());
        return static_cast<std::int64_t>(numberAt(bytes, 0, bytes.size()) << unused) >> unused;
    }
    if (kind < 12) {
        return {};
    }
    return kind % 2 == 0 ? Image::Column(Image::Bytes{std::string(bytes)}) : Image::Column(std::string(bytes));
}

/// The columns of a row's bytes; none when they are not those of a row.
std::vector<Image::Column> columnsOf(std::string_view bytes) {
    std::string_view head = bytes;
    const auto headSize = takeVariable(head);
    if (!headSize || *headSize > bytes.size() || *headSize < bytes.size() - head.size()) {
        return {};
    }
    head = bytes.substr(bytes.size() - head.size(), *headSize - (bytes.size() - head.size()));
    std::string_view body = bytes.substr(*headSize);
    std::vector<Image::Column> columns;
    while (!head.empty()) {
        const auto kind = takeVariable(head);
        if (!kind || columnSize(*kind) > body.size()) {
            return {};
        }
        columns.push_back(columnOf(*kind, body.substr(0, columnSize(*kind))));
        body.remove_prefix(columnSize(*kind));
    }
    return columns;
}

/// A page of a tree.
struct Node {
    explicit Node(std::string_view bytes, Number number)
        : page(bytes), head(number == 1 ? fileHeadSize : 0), kind(static_cast<unsigned>(numberAt(bytes, head, 1))) {}

    [[nodiscard]] bool isOne() const {
        return isInner(kind) || kind == leafIndex || kind == leafTable;
    }
    /// The bytes from a cell to the end of the page; empty when there is no such cell.
    [[nodiscard]] std::string_view cell(std::size_t index) const {
        const std::size_t pointers = head + (isInner(kind) ? 12 : 8);
        const std::size_t at = numberAt(page, pointers + 2 * index, 2);
        return at >= pointers && at < page.size() ? page.substr(at) : std::string_view();
    }
    [[nodiscard]] std::size_t cellCount() const {
        return std::min<std::size_t>(numberAt(page, head + 3, 2), page.size() / 4);
    }
    [[nodiscard]] std::vector<Number> children() const {
        std::vector<Number> found;
        for (std::size_t i = 0; isInner(kind) && i < cellCount(); ++i) {
            found.push_back(static_cast<Number>(numberAt(cell(i), 0, 4)));
        }
        if (isInner(kind)) {
            found.push_back(static_cast<Number>(numberAt(page, head + 8, 4)));
        }
        return found;
    }

    std::string_view page;
    std::size_t head;
    unsigned kind;
};

} // namespace

std::optional<std::uint32_t> Image::pageSizeOf(std::string_view file) {
    const auto size = static_cast<std::uint32_t>(numberAt(file, 16, 2));
    const std::uint32_t named = size == 1 ? 65536 : size;
    const bool isOne = file.starts_with("SQLite format 3") && named >= 512 && (named & (named - 1)) == 0;
    return isOne ? std::optional(named) : std::nullopt;
}

Image::Image(std::string_view file, std::string_view log, std::uint32_t pageSize) : m_file(file), m_pageSize(pageSize) {
    m_count = static_cast<Number>((file.size() + m_pageSize - 1) / m_pageSize);
    layOver(log);
    m_isSpent.resize(m_count + std::size_t{1});
}

/// Takes the pages of a log up to its last transaction that was ended.
void Image::layOver(std::string_view log) {
    constexpr std::size_t logHeadSize = 32;
    constexpr std::size_t frameHeadSize = 24;
    const std::size_t frameSize = frameHeadSize + m_pageSize;
    if (numberAt(log, 8, 4) != m_pageSize) {
        return;
    }
    std::map<Number, std::string_view> open;
    for (std::size_t at = logHeadSize; at + frameSize <= log.size(); at += frameSize) {
        if (log.substr(at + 8, 8) != log.substr(16, 8)) {
            break; // of an earlier use of the log
        }
        open[static_cast<Number>(numberAt(log, at, 4))] = log.substr(at + frameHeadSize, m_pageSize);
        if (const auto count = static_cast<Number>(numberAt(log, at + 4, 4)); count != 0) {
            for (const auto& [number, bytes] : open) {
                m_newer[number] = bytes;
            }
            open.clear();
            m_count = std::min<Number>(count, static_cast<Number>((m_file.size() + log.size()) / m_pageSize));
        }
    }
}

/// The bytes of a page that may be used, fewer at the end of a file that has been cut off.
std::string_view Image::page(Number number) const {
    if (number == 0 || number > m_count) {
        return {};
    }
    if (const auto newer = m_newer.find(number); newer != m_newer.end()) {
        return newer->second.substr(0, m_pageSize);
    }
    const std::size_t at = std::size_t{number - 1} * m_pageSize;
    return at < m_file.size() ? m_file.substr(at, m_pageSize) : std::string_view();
}

void Image::markFree(std::vector<bool>& isKnown) const {
    // Each page of the list names the next one and as many free pages as it has room for.
    auto list = static_cast<Number>(numberAt(page(1), 32, 4));
    while (list != 0 && list <= m_count && !isKnown[list]) {
        isKnown[list] = true;
        const std::string_view bytes = page(list);
        const std::size_t count = std::min<std::size_t>(numberAt(bytes, 4, 4), bytes.size() / 4);
        for (std::size_t i = 0; i < count; ++i) {
            const auto number = static_cast<Number>(numberAt(bytes, 8 + 4 * i, 4));
            if (number <= m_count) {
                isKnown[number] = true;
            }
        }
        list = static_cast<Number>(numberAt(bytes, 0, 4));
    }
}

std::vector<Number> Image::inOrder(const std::vector<Number>& roots) const {
    std::vector<Number> order;
    std::vector<bool> isKnown(m_count + std::size_t{1});
    const auto add = [&](Number number) {
        if (number != 0 && number <= m_count && !isKnown[number]) {
            isKnown[number] = true;
            order.push_back(number);
        }
    };
    std::ranges::for_each(roots, add);
    for (std::size_t i = 0; i < order.size(); ++i) {
        std::ranges::for_each(Node(page(order[i]), order[i]).children(), add);
    }
    markFree(isKnown);
    for (Number number = 1; number <= m_count; ++number) {
        add(number);
    }
    return order;
}

void Image::forEachRow(const std::vector<Number>& roots, const std::function<void(const Row& row)>& take) {
    for (const Number number : inOrder(roots)) {
        readRows(number, take);
    }
}

void Image::readRows(Number number, const std::function<void(const Row& row)>& take) {
    const Node node(page(number), number);
    if (!node.isOne() || node.kind == innerTable) {
        return;
    }
    for (std::size_t i = 0; i < node.cellCount(); ++i) {
        std::string_view cell = node.cell(i);
        cell.remove_prefix(std::min<std::size_t>(cell.size(), node.kind == innerIndex ? 4 : 0));
        Row row{node.kind == leafTable, 0, {}};
        const auto size = takeVariable(cell);
        const auto rowNumber = row.isOfTable ? takeVariable(cell) : std::optional<std::uint64_t>(0);
        if (!size || !rowNumber) {
            continue;
        }
        row.number = static_cast<std::int64_t>(*rowNumber);
        row.columns = columnsOf(payload(cell, *size, row.isOfTable));
        if (!row.columns.empty()) {
            take(row);
        }
    }
}

/// The bytes of a row, put together from its cell and the pages that a long one goes on in; empty when they are not
/// all there.
std::string Image::payload(std::string_view cell, std::uint64_t size, bool isOfTable) {
    const std::uint64_t longest = isOfTable ? m_pageSize - 35 : (m_pageSize - 12) * 64 / 255 - 23;
    if (size <= longest) {
        return size <= cell.size() ? std::string(cell.substr(0, size)) : std::string();
    }
    const std::uint64_t least = (m_pageSize - 12) * 32 / 255 - 23;
    const std::uint64_t fitting = least + (size - least) % (m_pageSize - 4);
    const std::uint64_t local = fitting <= longest ? fitting : least;
    if (local + 4 > cell.size() || size > std::uint64_t{m_count} * m_pageSize) {
        return {};
    }
    std::string bytes(cell.substr(0, local));
    auto next = static_cast<Number>(numberAt(cell, local, 4));
    while (bytes.size() < size) {
        const std::string_view more = page(next);
        if (more.size() < m_pageSize || m_isSpent[next]) {
            return {};
        }
        m_isSpent[next] = true;
        bytes += more.substr(4, std::min<std::uint64_t>(m_pageSize - 4, size - bytes.size()));
        next = static_cast<Number>(numberAt(more, 0, 4));
    }
    return bytes;
}

} // namespace tvx::registry
