// SPDX-License-Identifier: MIT
//
// Bytes as they are, on all roads. The first one says how many are held at a time.
#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "files.h"
#include "run.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static constexpr auto kWindowSizes = std::to_array<std::size_t>({1, 2, 3, 7, 16, 64, 256});
    if (size == 0) {
        return 0;
    }
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    umpre::fuzz::expectSameOnAllRoads(umpre::fuzz::Files::from(bytes.substr(1)),
                                      kWindowSizes[data[0] % kWindowSizes.size()]);
    return 0;
}
