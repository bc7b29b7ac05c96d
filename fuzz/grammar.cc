// SPDX-License-Identifier: MIT
//
// Files that a grammar makes, on all roads. Each byte chooses one of the ways to go on, so that
// most inputs hold directives, macros and calls, and small changes of an input are small changes of
// them. Calls stand in each other a few deep only: one that has its argument twice may double the
// work of what stands in it.
#include <array>
#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "files.h"
#include "run.h"

namespace umpre::fuzz {
namespace {

using std::string_view_literals::operator""sv;

// Where no bytes are left the first way is taken, which must therefore come to an end. "$" and a
// letter stand for one of the ways of that letter, "$$" for itself.
const std::map<char, std::vector<std::string_view>> kGrammar{
    // A file.
    {'f', {"", "$l$f", "$l$l$l$f", "$l$c$l$f"}},
    // Lines.
    {'l',
     {"\n", "$t\n", "$t$b$t\n", "$s#$s$d\n", "#$d\n", "#$d\n$t\n", "$c", "$t\r\n", "#$d\r\n",
      "$s#$s$d\r", "#$d$s\n$t\n", "#define $D\n$u\n"}},
    // A directive behind its "#".
    {'d',
     {"",
      "define $D",
      "define $D",
      "undef $n",
      "include \"$i\"",
      "include <$i>",
      "include $t",
      "line $k",
      "line $k \"$i\"",
      "line $t",
      "pragma $t",
      "error $t",
      "$n $t",
      "if $e",
      "elif $e",
      "else $t",
      "endif $t",
      "ifdef $n",
      "ifndef $n",
      "define $t",
      "undef $t",
      "if $t",
      "include $s\"$i\"$s$t",
      "define$s$D"}},
    // A group.
    {'c',
     {"#if $e\n#endif\n", "#if $e\n$f#endif\n", "#ifdef $n\n$f#else\n$f#endif\n",
      "#ifndef $n\n#define $n $b\n$f#endif\n", "#if $e\n$f#elif $e\n$f#else\n$f#endif\n",
      "#if 0\n$f#endif\n", "#if 0\n$f#elif 1\n$f#endif\n",
      "$s#$sif $e$s\n$f $s#$selse$s$t\n$f$s#$sendif$s$t\n"}},
    // What is defined.
    {'D',
     {"A 1", "$n $b", "$n(x) $b", "$n(x,y) $b", "$n() $b", "$n", "$n(x, y)$b", "F(x) [$b]",
      "G(x,y) x$b y", "$n$s$b", "A $u", "H() $u", "$n($n,$n)$b", "$n( x $b"}},
    // A name.
    {'n',
     {"A", "B", "C", "D", "F", "F", "G", "G", "H", "line", "if", "__LINE__", "__FILE__", "defined",
      "x", "y", "AB", "F1", "a_longer_name"}},
    // A use of a macro.
    {'u',
     {"A", "$n", "F($a)", "G($a,$a)", "H()", "$n($a)", "F ($a)", "$n$s($a", "F(F($a))",
      "G(F($a),A)", "F(\n$a\n)", "G($u$s,$s$u)", "F", "G", "$n$n", "F()", "G(,)"}},
    // An argument.
    {'a', {"", "1", "$t", "$u", "($t)", "\"$n\"", "$s$n$s", "$a,$a", "x$n"}},
    // A body.
    {'b', {"",     "1",      "x",    "#x",     "x##y", "x ## $n", "$n##x", "$t",
           "$u",   "x $b",   "$n x", "(x)",    "x x",  "$n $b",   "#$n",   "##",
           "$o$b", "$b##$b", "#y x", "x/**/y", "F",    "$n(x)",   "G(x,",  "x$o$b"}},
    // Text.
    {'t', {"", "$o", "$o$s$t", "$u", "$u $t", "$n$s$o$t", "$n,$o", "$u$u"}},
    // A token.
    {'o',
     {"1",
      "$n",
      "(",
      ")",
      ",",
      "#",
      "##",
      "\"$n\"",
      "'$n'",
      "/*$n*/",
      "/*\n*/",
      "//$n",
      "\\\n",
      "+",
      "-",
      "0x1f",
      "07u",
      ".",
      "e",
      "\"",
      "'",
      "\\",
      "\r",
      "\xE9",
      "\0"sv,
      "/*",
      "*/",
      "<",
      "=",
      "|",
      "&",
      "10ul",
      "0x",
      "08",
      "\\\r\n",
      "\t",
      "\f",
      "\"\\\"\"",
      "'\\''",
      "L'a'",
      "1.5e3",
      "$$",
      "@",
      "a_long_word_between_other_words ",
      "1000000, 2000000, "}},
    // Blanks.
    {'s', {"", " ", "  ", "\t", "/**/", "/* c */", "\\\n", "/*\n*/", " \\\r\n "}},
    // A condition.
    {'e',
     {"1", "0", "$x", "$x $q $x", "defined $n", "defined($n)", "!$e", "($e)", "$e ? $e : $e", "$u",
      "$e$s$q$s$e", "$n", "-$x", "$e $t", "($e$q$e)$q$x", "defined(A)$q!defined B", "$x$q$n$q$u"}},
    // A number.
    {'x',
     {"1", "0", "2u", "0x7fffffff", "2147483648", "'a'", "'\\377'", "1L", "017", "3", "'ab'",
      "0xFFFFFFFF", "4294967296", "A", "$n", "10"}},
    // An operator.
    {'q', {"+",  "-", "*", "/", "%",  "<<", ">>", "<", ">", "<=", ">=", "==",
           "!=", "&", "|", "^", "&&", "||", "?",  ":", ",", "=",  "#",  "~"}},
    // The name of a file.
    {'i', {"a", "b", "c", "d", "$n", "no/$n", "\\$n"}},
    // The number of a line.
    {'k', {"7", "1", "0", "$n", "2147483647", "4294967296", "0x10", "$x"}},
};

// What is to be written, its beginning last.
class Sentence {
public:
    explicit Sentence(std::string_view choices) : choices_(choices) {}

    [[nodiscard]] std::string make(std::string_view from) {
        std::string text;
        push(from);
        while (!pending_.empty()) {
            const char byte = take();
            const char letter = byte == '$' ? take() : '$';
            if (byte == kUseEnd) {
                --depth_;
            } else if (letter == '$') {
                text += byte;
            } else {
                const std::vector<std::string_view>& ways = kGrammar.at(letter);
                const std::size_t choice =
                    letter == 'u' ? chooseUse(ways.size()) : choose(ways.size());
                push(ways[choice]);
            }
        }
        return text;
    }

private:
    void push(std::string_view text) {
        pending_.insert(pending_.end(), text.rbegin(), text.rend());
    }

    [[nodiscard]] char take() {
        const char byte = pending_.back();
        pending_.pop_back();
        return byte;
    }

    // Where uses of macros stand too deep in each other, the first way has no other in it.
    [[nodiscard]] std::size_t chooseUse(std::size_t count) {
        constexpr int kDeepest = 6;
        pending_.push_back(kUseEnd);
        ++depth_;
        return depth_ > kDeepest ? 0 : choose(count);
    }

    [[nodiscard]] std::size_t choose(std::size_t count) {
        if (choices_.empty()) {
            return 0;
        }
        const auto choice = static_cast<unsigned char>(choices_.front());
        choices_.remove_prefix(1);
        return choice % count;
    }

    static constexpr char kUseEnd = '\x01';

    std::string_view choices_;
    std::string pending_;
    int depth_ = 0;  // of uses of macros
};

}  // namespace
}  // namespace umpre::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static constexpr auto kWindowSizes = std::to_array<std::size_t>({1, 3, 16, 64, 256});
    if (size == 0) {
        return 0;
    }
    umpre::fuzz::Sentence sentence({reinterpret_cast<const char*>(data) + 1, size - 1});
    const std::string input = sentence.make("$f\x1C$f\x1C$f\x1C$l$f");
    umpre::fuzz::expectSameOnAllRoads(umpre::fuzz::Files::from(input),
                                      kWindowSizes[data[0] % kWindowSizes.size()]);
    return 0;
}
