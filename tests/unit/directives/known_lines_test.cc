// SPDX-License-Identifier: MIT
#include "directives/known_lines.h"

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

namespace umpre {
namespace {

// A text as it stands in a file: more can be read behind it.
class Text {
public:
    explicit Text(std::string_view text) : memory_(text), size_(text.size()) {
        memory_.append(ByteBlock::kSize, '\n');
    }

    // In the place of a view. NOLINTNEXTLINE(google-explicit-constructor)
    operator std::string_view() const { return {memory_.data(), size_}; }

private:
    std::string memory_;
    std::size_t size_;
};

[[nodiscard]] std::string lineOf(std::size_t number) {
    return "#include <dir" + std::to_string(number % 7) + "/name" + std::to_string(number)
           + ".h>\n";
}

TEST(KnownLines, FindsALineByAllItsBytes) {
    KnownLines lines;
    Search search;
    EXPECT_EQ(lines.find(Text("#include <a.h>\n")), nullptr);
    lines.keep(Text("#include <a.h>\nrest"), search, 5);
    const KnownLines::Line* const line = lines.find(Text("#include <a.h>\nsomething else\n"));
    ASSERT_NE(line, nullptr);
    EXPECT_EQ(line->text.text(), "#include <a.h>\n");
    EXPECT_EQ(line->search, &search);
    EXPECT_EQ(line->macroNames, 5U);
    for (const std::string_view other : {
             "",
             "\n",
             "#include <a.h>",
             "#include <a.h",
             "#include <a.h> \n",
             "#include <b.h>\n",
             "#include  <a.h>\n",
             "#include \"a.h\"\n",
             " #include <a.h>\n",
             "#includE <a.h>\n",
         }) {
        EXPECT_EQ(lines.find(Text(other)), nullptr) << other;
    }
}

TEST(KnownLines, KeepsWhatWasSaidLast) {
    KnownLines lines;
    Search search;
    Search other;
    const Text text("#include <a.h>\n");
    lines.keep(text, search, 1);
    lines.find(text)->passage.moment = 7;
    lines.keep(text, other, 2);
    EXPECT_EQ(lines.find(text)->search, &other);
    EXPECT_EQ(lines.find(text)->macroNames, 2U);
    EXPECT_EQ(lines.find(text)->passage.moment, 0U);
}

TEST(KnownLines, KeepsLinesOfUpTo64Bytes) {
    for (std::size_t size = 12; size < 80; ++size) {
        const std::string line = "#include <" + std::string(size - 12, 'a') + ">\n";
        KnownLines lines;
        Search search;
        lines.keep(Text(line), search, 0);
        EXPECT_EQ(lines.find(Text(line)) != nullptr, size <= 64) << size;
    }
}

TEST(KnownLines, TellsApartLinesThatDifferInOneByte) {
    const std::string line = "#include \"a/long/name/of/some/folder/and/a/file/in/it.h\"\n";
    KnownLines lines;
    std::vector<Search> searches(line.size());
    const auto changed = [&line](std::size_t at) {
        std::string other = line;
        other[at] = '+';
        return other;
    };
    for (std::size_t at = 8; at + 1 < line.size(); ++at) {
        lines.keep(Text(changed(at)), searches[at], 0);
    }
    for (std::size_t at = 8; at + 1 < line.size(); ++at) {
        EXPECT_EQ(lines.find(Text(changed(at)))->search, &searches[at]) << at;
    }
    EXPECT_EQ(lines.find(Text(line)), nullptr);
}

TEST(KnownLines, KeepsManyLines) {
    constexpr std::size_t kMany = 20'000;
    KnownLines lines;
    std::vector<Search> searches(kMany);
    for (std::size_t number = 0; number < kMany; ++number) {
        lines.keep(Text(lineOf(number)), searches[number], number);
    }
    for (std::size_t number = 0; number < kMany; ++number) {
        ASSERT_EQ(lines.find(Text(lineOf(number)))->search, &searches[number]);
    }
    EXPECT_EQ(lines.find(Text(lineOf(kMany))), nullptr);
}

TEST(KnownLines, ForgetsLinesWhenThereAreVeryMany) {
    constexpr std::size_t kVeryMany = 50'000;
    KnownLines lines;
    Search search;
    for (std::size_t number = 0; number < kVeryMany; ++number) {
        lines.keep(Text(lineOf(number)), search, number);
    }
    EXPECT_EQ(lines.find(Text(lineOf(0))), nullptr);
    EXPECT_EQ(lines.find(Text(lineOf(kVeryMany - 1)))->macroNames, kVeryMany - 1);
}

}  // namespace
}  // namespace umpre
