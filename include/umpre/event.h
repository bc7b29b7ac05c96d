// SPDX-License-Identifier: MIT
#ifndef UMPRE_EVENT_H
#define UMPRE_EVENT_H

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace umpre {

/// Something that a run did. The views are valid during the call that brings it.
struct Event {
    /// What it did. More kinds may come; what is not known is best passed over.
    enum class Kind {
        FileEntered,  ///< the source or an included file was opened
        FileMissed    ///< an included file was looked for under this name and is not there
    };

    Kind kind = Kind::FileEntered;  ///< what it did
    std::string_view name;          ///< the file's, as it was opened; empty for standard input
    std::string_view file;          ///< where that was asked for; empty for the source
    std::int32_t line = 0;          ///< the line in that file
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
