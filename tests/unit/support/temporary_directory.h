// SPDX-License-Identifier: MIT
#ifndef UMPRE_TESTS_UNIT_SUPPORT_TEMPORARY_DIRECTORY_H
#define UMPRE_TESTS_UNIT_SUPPORT_TEMPORARY_DIRECTORY_H

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>
#include <string>
#include <string_view>
#include <system_error>

#include <gtest/gtest.h>

namespace umpre::testing {

[[nodiscard]] inline std::string contentsOf(const std::string& fileName) {
    std::ifstream file(fileName, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

/// A directory of its own for one test, removed with all that is in it.
class TemporaryDirectory {
public:
    TemporaryDirectory() : name_(::testing::TempDir() + "umpre-XXXXXX") {
        if (::mkdtemp(name_.data()) == nullptr) {
            throw std::runtime_error("no temporary directory");
        }
    }

    TemporaryDirectory(const TemporaryDirectory&) = delete;
    TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;

    ~TemporaryDirectory() {
        std::error_code ignored;
        std::filesystem::remove_all(name_, ignored);
    }

    [[nodiscard]] const std::string& name() const noexcept { return name_; }

    /// Returns the full name of a file in the directory.
    [[nodiscard]] std::string nameOf(std::string_view file) const {
        return name_ + "/" + std::string(file);
    }

    /// Writes a file, its folders too, and returns its full name.
    std::string write(std::string_view file, std::string_view contents) const {
        std::string fileName = nameOf(file);
        std::filesystem::create_directories(std::filesystem::path(fileName).parent_path());
        std::ofstream(fileName, std::ios::binary) << contents;
        return fileName;
    }

private:
    std::string name_;
};

}  // namespace umpre::testing

#endif
