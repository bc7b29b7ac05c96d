// SPDX-License-Identifier: MIT
#ifndef UMPRE_EVENT_H
#define UMPRE_EVENT_H

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace umpre {

/// Something that a run did. The views are valid during the call that brings it.
///
/// A macro that a directive expands has the place of the directive, that of its `#`. In text, all
/// that the replacement of a name leads to has the place of that name.
struct Event {
    /// What it did. More kinds may come; what is not known is best passed over.
    enum class Kind {
        /// The source or an included file was opened. The place is that of the `#include`.
        FileEntered,
        /// An included file was looked for under this name and is not there. The place is that of
        /// the `#include`.
        FileMissed,
        /// The end of a file was reached. The place is where reading goes on. What ends a run
        /// before its input does leaves no file.
        FileLeft,
        /// A name got a definition, or one with another text. The place is that of the `#define`;
        /// that of predefined macros and of Preprocessing::define is empty, and they come before
        /// the source is entered. A definition that changes nothing is not told of.
        MacroDefined,
        /// A name lost its definition. The place is that of the `#undef`, which is not told of if
        /// there was no definition.
        MacroUndefined,
        /// The name of a macro was replaced, in text, in a directive, in an argument or in another
        /// replacement; with all of its arguments read, but not yet expanded. Not told of are a
        /// name that stays as it is, the operand of `defined`, and arguments of which only the
        /// spelling is used, by `#` or `##`. An argument that is used several times is expanded
        /// once, unless that reports a problem or passes a comment with line ends.
        MacroExpanded
    };

    Kind kind = Kind::FileEntered;  ///< what it did
    /// The file's, as it was opened, which is empty for standard input; or the macro's.
    std::string_view name;
    /// Where that was, as messages name the file; empty where the source itself is entered or left,
    /// and before.
    std::string_view file;
    std::int32_t line = 0;  ///< the line in that file; 0 where there is none
};

/// Which events an observer is told of.
enum class EventScope {
    Files,          ///< those of files
    FilesAndMacros  ///< all; expanding macros then takes longer
};

/// Is told what a run does. It must not throw, and it must not use the Preprocessing that runs.
using Observer = std::function<void(const Event&)>;

/// What a resolver says about a file that is looked for.
struct IncludeAnswer {
    /// Where the file is.
    enum class Kind {
        Disk,    ///< where its name says, or not at all
        Absent,  ///< nowhere
        Text     ///< here: its text follows
    };

    Kind kind = Kind::Disk;  ///< where the file is
    std::string text;        ///< the contents of the file, for Kind::Text
};

/// Is asked for every name under which an included file is looked for, in their order, before the
/// disk is. It must not throw, and it must not use the Preprocessing that runs.
using IncludeResolver = std::function<IncludeAnswer(std::string_view name)>;

}  // namespace umpre

#endif
