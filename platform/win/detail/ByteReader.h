#pragma once

#include "platform/win/Module.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string>

namespace tvx::detail {

/// Reads little-endian numbers and texts in order and never beyond the end. Once something did not fit, every later
/// reading answers 0 or nothing and `ok()` is false, so a parser may read a whole structure and ask once.
class ByteReader {
public:
    explicit ByteReader(ResourceBytes bytes) : m_bytes(bytes) {}

    [[nodiscard]] bool ok() const {
        return m_ok;
    }
    [[nodiscard]] std::size_t position() const {
        return m_position;
    }
    [[nodiscard]] std::size_t remaining() const {
        return m_bytes.size() - m_position;
    }

    std::uint8_t u8() {
        return static_cast<std::uint8_t>(number(1));
    }
    std::uint16_t u16() {
        return static_cast<std::uint16_t>(number(2));
    }
    std::uint32_t u32() {
        return number(4);
    }
    std::int16_t s16() {
        return static_cast<std::int16_t>(u16());
    }
    std::int32_t s32() {
        return static_cast<std::int32_t>(u32());
    }

    /// The number ahead without moving; 0 when there is none left, which is no failure.
    [[nodiscard]] std::uint16_t peekU16() const {
        ByteReader ahead = *this;
        return ahead.u16();
    }

    /// The next `count` bytes, empty when fewer are left.
    ResourceBytes bytes(std::size_t count) {
        if (!m_ok || count > remaining()) {
            return fail();
        }
        const ResourceBytes result = m_bytes.subspan(m_position, count);
        m_position += count;
        return result;
    }

    void skip(std::size_t count) {
        bytes(count);
    }

    /// Moves on to the next multiple of `unit`. Padding that is missing at the very end is no failure.
    void align(std::size_t unit) {
        const std::size_t target = (m_position + unit - 1) / unit * unit;
        m_position = std::min(target, m_bytes.size());
    }

    /// `count` UTF-16 units, without an end mark.
    std::u16string text(std::size_t count) {
        std::u16string result;
        if (count > remaining() / 2) {
            fail();
            return result;
        }
        result.reserve(count);
        for (std::size_t i = 0; i < count; ++i) {
            result.push_back(static_cast<char16_t>(u16()));
        }
        return result;
    }

    /// UTF-16 units up to a zero, which is consumed.
    std::u16string zeroEndedText() {
        std::u16string result;
        while (const std::uint16_t unit = u16()) {
            result.push_back(static_cast<char16_t>(unit));
        }
        return result;
    }

private:
    std::uint32_t number(std::size_t size) {
        const ResourceBytes raw = bytes(size);
        std::uint32_t value = 0;
        for (std::size_t i = raw.size(); i-- > 0;) {
            value = value << 8 | raw[i];
        }
        return value;
    }
    ResourceBytes fail() {
        m_ok = false;
        m_position = m_bytes.size();
        return {};
    }

    ResourceBytes m_bytes;
    std::size_t m_position = 0;
    bool m_ok = true;
};

} // namespace tvx::detail
