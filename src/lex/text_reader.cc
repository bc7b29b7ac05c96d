// SPDX-License-Identifier: MIT
#include "lex/text_reader.h"

namespace umpre {

TextReader::Stop TextReader::copyText(CppFileScanner& file, Stop from) {
    if (from == Stop::LineStart && file.isAtHash()) {
        return from;
    }
    Stop stop = from;
    bool goesOn = true;
    while (goesOn && !output_.failed()) {
        TextCopy copy(output_, macroNames_, nameReader_, file, stop);
        if (copy.isUsedUp()) {
            return stop;  // there are no bytes ahead
        }
        stop = copy.copy(stop);
        name_ = copy.name();
        goesOn = stop != Stop::Name && copy.isUsedUp();
    }
    return stop;
}

}  // namespace umpre
