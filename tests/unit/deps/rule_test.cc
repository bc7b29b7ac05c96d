// SPDX-License-Identifier: MIT
#include "deps/rule.h"

#include <string_view>

#include <gtest/gtest.h>

#include "deps/command_line.h"

namespace umpre {
namespace {

struct Row {
    std::string_view name;
    std::string_view file;
    std::string_view target;
};

TEST(Rule, EscapesNames) {
    const Row table[]{
        {"", "", ""},
        {"a.h", "a.h", "a.h"},
        {"a b", "a\\ b", "a\\ b"},
        {"a\tb", "a\\\tb", "a\\\tb"},
        {"a#b", "a\\#b", "a\\#b"},
        {"a:b", "a\\:b", "a\\:b"},
        {"$a$$", "$$a$$$$", "$$a$$$$"},
        {"a%b", "a%b", "a\\%b"},
        {"a\\b", "a\\b", "a\\b"},
        {"a\\ b", "a\\\\\\ b", "a\\\\\\ b"},
        {"a\\\\#", "a\\\\\\\\\\#", "a\\\\\\\\\\#"},
        {"a\\%", "a\\%", "a\\\\\\%"},
    };
    for (const Row& row : table) {
        EXPECT_EQ(escapedFile(row.name), row.file) << row.name;
        EXPECT_EQ(escapedTarget(row.name), row.target) << row.name;
    }
}

TEST(Rule, HasAllItsTargetsInEveryPart) {
    EXPECT_EQ(textOf({{"a", "b"}, {"c", "d"}, {"e"}, true}),
              "a b: \\\n  c \\\n  d\na b: $(wildcard e)\nd:\n");
}

TEST(Rule, AsksMakeForAbsentFilesByPatterns) {
    EXPECT_EQ(textOf({{"a"}, {"b"}, {"c,d", "e f", "g[h]", "i\\ j", "k:l"}, false}),
              "a: \\\n  b\na: $(wildcard c,d)\na: $(if $(wildcard e\\ f),e\\ f)\n"
              "a: $(if $(wildcard g\\[h]),g[h])\n"
              "a: $(if $(wildcard i\\\\\\\\\\ j),i\\\\\\ j)\n"
              "a: $(if $(wildcard k:l),k\\:l)\n");
}

TEST(WithSuffix, ReplacesThatOfTheLastPart) {
    EXPECT_EQ(withSuffix("a.src", ".o"), "a.o");
    EXPECT_EQ(withSuffix("a.b/c", ".o"), "a.b/c.o");
    EXPECT_EQ(withSuffix("a/b.c.d", ".o"), "a/b.c.o");
    EXPECT_EQ(withSuffix("a/.b", ".o"), "a/.b.o");
    EXPECT_EQ(withSuffix("", ".o"), ".o");
}

}  // namespace
}  // namespace umpre
