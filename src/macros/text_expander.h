// SPDX-License-Identifier: MIT
#ifndef UMPRE_MACROS_TEXT_EXPANDER_H
#define UMPRE_MACROS_TEXT_EXPANDER_H

#include <cstddef>
#include <memory>
#include <string_view>
#include <vector>

#include "lex/growing_array.h"
#include "macros/argument_texts.h"
#include "macros/macro_body.h"
#include "macros/macro_table.h"
#include "macros/operand_join.h"
#include "macros/text_buffer.h"
#include "macros/text_places.h"

namespace umpre {

/// Expands macros as bytes, with no tokens made. Whatever is more than a matter of bytes it leaves
/// to the token road, with nothing done: what reports a problem, writes a line end, hangs on where
/// it stands (`__FILE__`, `__LINE__`), or would go on behind the text at hand.
class TextExpander {
public:
    TextExpander(MacroTable& macros, BodyMaker& bodies) noexcept
        : macros_(macros), bodies_(bodies) {}

    /// Adds to `to` what an object-like macro comes out as where a file's text uses it, and makes
    /// the table watch all names that this hangs on. Returns false if that is not told; `to` is
    /// spoilt then.
    [[nodiscard]] bool expandObject(const MacroName& name, TextBuffer& to);

    /// The same for the call of a function-like macro, of whose name the end is at `behind`, with
    /// all that it needs before `end`. Returns where the call ends, or null if that is not told. No
    /// name is watched.
    [[nodiscard]] const char* expandCall(const MacroName& name, const char* behind, const char* end,
                                         TextBuffer& to);

private:
    // Where a text stands that is read, and with it, what becomes of names that stay in it.
    enum class Place {
        Replacement,     // of a macro in text: they are only written
        Argument,        // they go on as names of the replacement that the argument becomes part of
        WithinArgument,  // a replacement in an argument: they would have another set of names
    };

    // What reading yields.
    struct Result {
        TextBuffer& text;
        bool isWritten = false;  // it is only written, not read again
        bool hasMacros = false;  // names of macros were left in it
    };

    // A text that is read.
    struct Reading {
        const char* end = nullptr;
        const char* run = nullptr;  // what is not added yet begins here
        Place place = Place::Replacement;
        TextPlaces<PlacesFor::Tokens> places;
    };

    [[nodiscard]] const char* expand(const MacroName& name, const char* behind, const char* end,
                                     TextBuffer& to);
    [[nodiscard]] bool read(std::string_view text, const std::vector<TextBuffer::Part>& settled,
                            Place place, Result& result);
    [[nodiscard]] bool readUpTo(const char* end, Reading& reading, Result& result);
    [[nodiscard]] bool readName(const char* at, Reading& reading, Result& result);
    [[nodiscard]] bool stays(const MacroName& name, const char* behind, const char* end,
                             Place place) const;
    [[nodiscard]] const char* replace(const MacroName& name, const char* behind, const char* end,
                                      Place place, Result& result);
    [[nodiscard]] static Place within(Place place) noexcept;
    [[nodiscard]] const char* replaceCall(const MacroName& name, const char* open, const char* end,
                                          Place place, Result& result);
    [[nodiscard]] bool addReplacement(const MacroName& name, const MacroBody& body,
                                      std::size_t firstArgument, Place place, Result& result);
    [[nodiscard]] bool substitute(const MacroBody& body, std::size_t firstArgument, Result& result);
    [[nodiscard]] bool addSettled(const MacroBody& body, std::size_t firstArgument, Result& result);
    [[nodiscard]] bool addStep(const MacroBody& body, const BodyStep& step,
                               std::size_t firstArgument, Result& result);
    [[nodiscard]] const std::string_view* textOf(const BodyStep& step,
                                                 std::size_t firstArgument) const;
    [[nodiscard]] bool addArgument(std::size_t argument, Result& result);
    [[nodiscard]] bool addJoined(const MacroBody& body, const BodyStep& step,
                                 std::size_t firstArgument, Result& result);
    [[nodiscard]] bool isPlain(std::string_view text, bool& hasMacros);
    [[nodiscard]] bool isTooMuch(std::size_t bytes);
    [[nodiscard]] static bool meets(std::size_t before, const Result& result);
    [[nodiscard]] static bool add(std::string_view text, Result& result);
    [[nodiscard]] bool addCounted(std::string_view text, Result& result);
    [[nodiscard]] bool hasMacros(const MacroBody& body, const BodyStep& step);
    [[nodiscard]] bool hasMacros(const MacroBody& body) const;
    [[nodiscard]] const MacroName* macroOf(std::string_view name);
    [[nodiscard]] bool isAround(const MacroName& name) const;
    [[nodiscard]] TextBuffer& takeBuffer();

    MacroTable& macros_;
    BodyMaker& bodies_;
    bool watches_ = false;
    std::size_t depth_ = 0;                 // of texts that are read
    std::size_t work_ = 0;                  // bytes read and written for one name of the text
    std::vector<const MacroName*> around_;  // whose replacements are read, the innermost one last
    GrowingArray<ArgumentText> arguments_;  // of the calls that are replaced
    CallOutline outline_;                   // of the arguments of the call in the text
    std::vector<std::unique_ptr<TextBuffer>> buffers_;  // the first of them in use
    std::size_t buffersUsed_ = 0;
    OperandJoin join_;
};

}  // namespace umpre

#endif
