// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_SMALL_STACK_H
#define UMPRE_TESTS_UNIT_SUPPORT_SMALL_STACK_H

#include <cstddef>
#include <functional>
#include <pthread.h>
#include <stdexcept>

namespace umpre::testing {

/// Does the work on a stack of 256 KiB and waits for it. Work that calls itself a thousand times
/// does not end well there.
inline void onSmallStack(std::function<void()> work) {
    constexpr std::size_t kSize = std::size_t{256} * 1024;
    pthread_attr_t attributes;
    pthread_t thread{};
    const auto run = [](void* argument) -> void* {
        (*static_cast<std::function<void()>*>(argument))();
        return nullptr;
    };
    ::pthread_attr_init(&attributes);
    ::pthread_attr_setstacksize(&attributes, kSize);
    if (::pthread_create(&thread, &attributes, run, &work) != 0) {
        throw std::runtime_error("no thread");
    }
    ::pthread_join(thread, nullptr);
    ::pthread_attr_destroy(&attributes);
}

}  // namespace umpre::testing

#endif
