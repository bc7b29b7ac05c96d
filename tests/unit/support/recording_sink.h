// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_RECORDING_SINK_H
#define UMPRE_TESTS_UNIT_SUPPORT_RECORDING_SINK_H

#include <cstddef>
#include <limits>
#include <string>
#include <string_view>

#include "lex/byte_sink.h"

namespace umpre::testing {

/// Keeps what is written, and fails from the given call on, counted from 1.
class RecordingSink final : public ByteSink {
public:
    RecordingSink() = default;

    explicit RecordingSink(std::size_t firstFailure) noexcept : firstFailure_(firstFailure) {}

    [[nodiscard]] bool write(std::string_view bytes) override {
        ++calls_;
        if (calls_ >= firstFailure_) {
            return false;
        }
        bytes_.append(bytes);
        return true;
    }

    [[nodiscard]] const std::string& bytes() const noexcept { return bytes_; }

    void clear() { bytes_.clear(); }

    [[nodiscard]] std::size_t calls() const noexcept { return calls_; }

private:
    std::size_t firstFailure_ = std::numeric_limits<std::size_t>::max();
    std::size_t calls_ = 0;
    std::string bytes_;
};

}  // namespace umpre::testing

#endif
