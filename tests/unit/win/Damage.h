#pragma once

#include "platform/win/Module.h"

#include <gtest/gtest.h>

#include <memory>
#include <vector>

/// Resource data in memory of exactly its length, so that the sanitizer sees every read beyond the end.
class ExactBytes {
public:
    explicit ExactBytes(tvx::ResourceBytes bytes)
        : m_size(bytes.size()), m_bytes(std::make_unique<std::uint8_t[]>(bytes.size())) {
        std::copy(bytes.begin(), bytes.end(), m_bytes.get());
    }
    [[nodiscard]] tvx::ResourceBytes view() const {
        return {m_bytes.get(), m_size};
    }
    void flip(std::size_t bit) {
        m_bytes[bit / 8] ^= static_cast<std::uint8_t>(1u << bit % 8);
    }

private:
    std::size_t m_size;
    std::unique_ptr<std::uint8_t[]> m_bytes;
};

/// Every beginning of `data` shorter than `needed` bytes must be refused with a reason.
template <class Parse>
void expectTruncationsRefused(tvx::ResourceBytes data, std::size_t needed, Parse parse) {
    ASSERT_GT(needed, 0u);
    ASSERT_TRUE(parse(data)) << parse(data).reason();
    for (std::size_t length = 0; length < needed; ++length) {
        const ExactBytes part(data.first(length));
        const auto outcome = parse(part.view());
        EXPECT_FALSE(outcome) << "accepted the first " << length << " of " << data.size() << " bytes";
        EXPECT_FALSE(outcome.reason().empty());
    }
}

/// Reads `data` with each bit flipped in turn: the outcome is open, reading beyond the end is not.
template <class Parse>
void parseWithFlippedBits(tvx::ResourceBytes data, Parse parse) {
    ExactBytes copy(data);
    for (std::size_t bit = 0; bit < data.size() * 8; ++bit) {
        copy.flip(bit);
        const auto outcome = parse(copy.view());
        EXPECT_EQ(outcome.reason().empty(), static_cast<bool>(outcome));
        copy.flip(bit);
    }
}
