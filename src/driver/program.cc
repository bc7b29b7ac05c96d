// SPDX-License-Identifier: MIT
#include "driver/program.h"

#include <exception>
#include <new>
#include <unistd.h>

#include "driver/standard_descriptors.h"
#include "lex/byte_sink.h"
#include "lex/scanner_failure.h"

namespace umpre {
namespace {

constexpr int kStatusWithoutMemory = 2;

int reportNoMemory() {
    DescriptorSink errors(STDERR_FILENO);
    (void)(errors.write(kNoMemory) && errors.write("\n"));
    return kStatusWithoutMemory;
}

// Called where there is not even the memory to throw an exception.
[[noreturn]] void endWithoutMemory() {
    ::_exit(reportNoMemory());
}

}  // namespace

int runProgram(int (*program)(int argc, char** argv), int argc, char** argv) {
    std::set_terminate(endWithoutMemory);
    openStandardDescriptors();
    try {
        return program(argc, argv);
    } catch (const std::bad_alloc&) {
        return reportNoMemory();
    }
}

}  // namespace umpre
