// SPDX-License-Identifier: MIT
#ifndef UMPRE_FUZZ_RUN_H
#define UMPRE_FUZZ_RUN_H

#include <cstddef>

#include "files.h"

namespace umpre::fuzz {

/// Runs over files on every road: token by token, with all shortcuts, and with all of them on
/// windows of some bytes. Ends the process unless each gives the same output, the same messages,
/// asks for the same files and comes to the same end.
///
/// A run has limits: of the bytes that it writes, of the memory that it holds and of the files that
/// it includes. Where it meets one of the first two, what came before must be the same.
void expectSameOnAllRoads(const Files& files, std::size_t windowSize);

}  // namespace umpre::fuzz

#endif
