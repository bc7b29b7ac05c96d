// SPDX-License-Identifier: MIT
#include <csignal>
#include <unistd.h>

#include "driver/command_line.h"
#include "driver/diagnostics.h"
#include "driver/output_file.h"
#include "driver/preprocessor.h"
#include "driver/program.h"

#ifndef UMPRE_PLAIN_ROAD
#define UMPRE_PLAIN_ROAD false
#endif

namespace {

enum Status { kClean = 0, kErrors = 1, kScannerFailure = 2 };

// Ends the process as a failing machine division does, on every machine.
void raiseArithmeticFault() {
    sigset_t signals;
    sigemptyset(&signals);
    sigaddset(&signals, SIGFPE);
    (void)::sigprocmask(SIG_UNBLOCK, &signals, nullptr);
    (void)std::signal(SIGFPE, SIG_DFL);
    (void)std::raise(SIGFPE);
}

int preprocess(int argc, char** argv) {
    umpre::DescriptorSink errors(STDERR_FILENO);
    umpre::OutputFile output;
    umpre::RunOptions options;
    options.plainRoad = UMPRE_PLAIN_ROAD;
    umpre::Preprocessor preprocessor(umpre::linesTo(errors), options);
    auto result = umpre::RunResult::Errors;
    if (umpre::parseCommandLine(preprocessor, {output, errors}, argc, argv)) {
        result = preprocessor.run();
    }
    if (result == umpre::RunResult::ArithmeticFault) {
        raiseArithmeticFault();
    }
    const bool isWritten = output.close();
    if (!isWritten) {
        (void)errors.write(output.failureMessage());
    }
    if (result == umpre::RunResult::ScannerFailure) {
        return kScannerFailure;
    }
    return isWritten && result == umpre::RunResult::Clean ? kClean : kErrors;
}

}  // namespace

int main(int argc, char** argv) {
    return umpre::runProgram(preprocess, argc, argv);
}
