// SPDX-License-Identifier: MIT
#include "directives/file_keeper.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

[[nodiscard]] std::string bytesOf(const KnownFile& file) {
    return file.bytes == nullptr ? "nothing" : std::string(file.bytes->begin(), file.bytes->size());
}

TEST(FileKeeper, KeepsTheBytesOfAFile) {
    FileKeeper keeper;
    const auto file = std::make_shared<KnownFile>();
    keeper.keep(file, "a\nb\n");
    EXPECT_EQ(bytesOf(*file), "a\nb\n");
}

TEST(FileKeeper, KeepsNothingOfWhatIsEmptyOrVeryLarge) {
    FileKeeper keeper;
    const auto file = std::make_shared<KnownFile>();
    keeper.keep(file, "");
    EXPECT_EQ(file->bytes, nullptr);
    keeper.keep(file, std::string(FileKeeper::kMostBytes / 8 + 1, 'x'));
    EXPECT_EQ(file->bytes, nullptr);
}

TEST(FileKeeper, MakesRoomWhereItKeptFirst) {
    FileKeeper keeper;
    std::vector<std::shared_ptr<KnownFile>> files;
    const std::string text(FileKeeper::kMostBytes / 8, 'x');
    for (int number = 0; number < 10; ++number) {
        files.push_back(std::make_shared<KnownFile>());
        keeper.keep(files.back(), text);
    }
    EXPECT_EQ(files[0]->bytes, nullptr);
    EXPECT_EQ(files[1]->bytes, nullptr);
    EXPECT_EQ(bytesOf(*files[2]), text);
    EXPECT_EQ(bytesOf(*files[9]), text);
}

}  // namespace
}  // namespace umpre
