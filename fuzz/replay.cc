// SPDX-License-Identifier: MIT
//
// Gives files to a target, once each and in the order of their names, without a fuzzer.
#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <string>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace {

namespace fs = std::filesystem;

[[nodiscard]] std::vector<fs::path> filesOf(const fs::path& path) {
    if (!fs::is_directory(path)) {
        return {path};
    }
    std::vector<fs::path> files;
    for (const fs::directory_entry& entry : fs::directory_iterator(path)) {
        files.push_back(entry.path());
    }
    std::sort(files.begin(), files.end());
    return files;
}

}  // namespace

int main(int argc, char** argv) {
    std::size_t count = 0;
    for (int index = 1; index < argc; ++index) {
        for (const fs::path& path : filesOf(argv[index])) {
            std::ifstream file(path, std::ios::binary);
            std::string text(file ? fs::file_size(path) : 0, '\0');
            if (!file.read(text.data(), static_cast<std::streamsize>(text.size()))) {
                std::cerr << "cannot read " << path << '\n';
                return 1;
            }
            std::cout << path.filename().string() << std::endl;  // which says where it stopped
            LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(text.data()), text.size());
            ++count;
        }
    }
    std::cout << count << " inputs\n";
    return count == 0 ? 1 : 0;
}
