// SPDX-License-Identifier: MIT
#ifndef UMPRE_FUZZ_CHECK_H
#define UMPRE_FUZZ_CHECK_H

#include <string>
#include <string_view>

namespace umpre::fuzz {

/// Ends the process with a message, so that the fuzzer keeps its input.
[[noreturn]] void fail(std::string_view message);

/// Returns bytes as they can be printed.
[[nodiscard]] std::string printable(std::string_view bytes);

/// Says how a text differs from what it should be; nothing if it does not.
[[nodiscard]] std::string differenceOf(std::string_view what, std::string_view found,
                                       std::string_view expected);

/// Ends the process unless both texts are equal.
void expectSame(std::string_view what, std::string_view found, std::string_view expected);

}  // namespace umpre::fuzz

#endif
