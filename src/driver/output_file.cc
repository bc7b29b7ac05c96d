// SPDX-License-Identifier: MIT
#include "driver/output_file.h"

#include <fcntl.h>
#include <unistd.h>

namespace umpre {

OutputFile::~OutputFile() {
    (void)close();
}

bool OutputFile::open(const std::string& name) {
    const int descriptor = ::open(name.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0666);
    if (descriptor < 0) {
        return false;
    }
    descriptor_ = descriptor;
    name_ = name;
    return true;
}

bool OutputFile::write(std::string_view bytes) {
    failed_ = failed_ || !DescriptorSink(descriptor_).write(bytes);
    return !failed_;
}

std::optional<FileIdentity> OutputFile::target() const {
    return DescriptorSink(descriptor_).target();
}

bool OutputFile::close() {
    if (descriptor_ >= 0) {
        failed_ = ::close(descriptor_) != 0 || failed_;
        descriptor_ = -1;
    }
    return !failed_;
}

std::string OutputFile::failureMessage() const {
    const std::string program(program_);
    return name_.empty() ? program + ": cannot write to standard output\n"
                         : program + ": cannot write output file '" + name_ + "'\n";
}

std::string OutputFile::openFailureMessage(const std::string& name) const {
    return std::string(program_) + ": cannot open output file '" + name + "'\n";
}

}  // namespace umpre
