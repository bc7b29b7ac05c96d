// SPDX-License-Identifier: MIT
//
// On the token road a replacement is tokens with a set of names that must not be expanded in it,
// pushed to be read again. Here it is a text, added to what comes out. With
//
//     #define MAX(a, b) ((a) > (b) ? (a) : (b))
//     #define LIMIT(x) MAX(x, FLOOR)
//     #define FLOOR 0
//
// LIMIT(y + 1) is read as "MAX(y + 1, FLOOR)", because its body has names of macros; of that, the
// arguments come out as "y + 1" and "0", and MAX is replaced by the texts of its body and of these,
// which hold no macro and are not read again.
//
// A text stands for tokens only if lexing it yields these tokens. Texts that are put together are
// told apart from others by the bytes that meet (`mayMeet`), and every token is looked at, so that
// none is a comment, a line end or a lone quote. The set of names that must not be expanded is that
// of the replacements around, the same for all of a text: for an argument's names it is, because
// they have the set of the call, to which the replacement's is added. Names of macros that stay in
// a replacement within an argument had another set, so they are left to the token road, as is a
// function-like macro's name at the end of a replacement, whose "(" may follow.
//
// What is done for every token and every part is inline: calls of small macros take 7 % less then.
#include "macros/text_expander.h"

#include <algorithm>

#include "lex/plain_text.h"
#include "lex/token_join.h"
#include "macros/argument_texts.h"
#include "macros/predefined_macros.h"

namespace umpre {
namespace {

// The token road has quicker ways to nest deeply, and takes no memory for what is large.
constexpr std::size_t kDeepest = 128;
constexpr std::size_t kMostWork = std::size_t{8} << 20U;  // bytes
constexpr std::size_t kWorkOfReading = 16;

const std::vector<TextBuffer::Part> kNoParts;

[[nodiscard]] std::string_view viewOf(const char* begin, const char* end) noexcept {
    return {begin, static_cast<std::size_t>(end - begin)};
}

}  // namespace

bool TextExpander::expandObject(const MacroName& name, TextBuffer& to) {
    if (bodies_.tellsMacros()) {
        return false;
    }
    watches_ = true;
    macros_.watch(name.text);
    // The text around ends with the name.
    const char* const behind = name.text.data() + name.text.size();
    return expand(name, behind, behind, to) != nullptr;
}

const char* TextExpander::expandCall(const MacroName& name, const char* behind, const char* end,
                                     TextBuffer& to) {
    watches_ = false;
    return expand(name, behind, end, to);
}

const char* TextExpander::expand(const MacroName& name, const char* behind, const char* end,
                                 TextBuffer& to) {
    depth_ = 0;
    work_ = 0;
    around_.clear();
    arguments_.clear();
    outline_.clear();
    buffersUsed_ = 0;
    Result result{to, true};
    return replace(name, behind, end, Place::Replacement, result);
}

// Reads a text, but for the parts that are settled, and adds what it comes out as. As everything
// here it returns false, or null, if that is not told by bytes; nothing is cleaned up then.
bool TextExpander::read(std::string_view text, const std::vector<TextBuffer::Part>& settled,
                        Place place, Result& result) {
    ++depth_;
    work_ += text.size() + kWorkOfReading;
    if (depth_ > kDeepest || work_ > kMostWork) {
        return false;
    }
    const char* const end = text.data() + text.size();
    Reading reading{end, text.data(), place, TextPlaces<PlacesFor::Tokens>(text.data())};
    // Behind the last part that is settled is one without bytes.
    const TextBuffer::Part last{text.size(), text.size()};
    for (std::size_t index = 0; index <= settled.size(); ++index) {
        const TextBuffer::Part& part = index < settled.size() ? settled[index] : last;
        if (!readUpTo(text.data() + part.begin, reading, result)) {
            return false;
        }
        reading.places.resume(text.data() + part.end);
    }
    --depth_;
    return add(viewOf(reading.run, end), result);
}

inline bool TextExpander::readUpTo(const char* end, Reading& reading, Result& result) {
    for (;;) {
        const char* const at = reading.places.next(end);
        if (at == end) {
            return true;
        }
        if (isNameStart(*at)) {
            if (!readName(at, reading, result)) {
                return false;
            }
        } else if (isDigit(*at)) {
            (void)reading.places.passNumber(at);
        } else {
            const char* const behind = unusualTokenEnd(at, end);
            if (behind == nullptr) {
                return false;
            }
            reading.places.resume(behind);
        }
    }
}

bool TextExpander::readName(const char* at, Reading& reading, Result& result) {
    const char* const behind = reading.places.passName(at);
    const MacroName* const name = macroOf(viewOf(at, behind));
    if (name == nullptr) {
        return true;
    }
    if (stays(*name, behind, reading.end, reading.place)) {
        result.hasMacros = true;
        return true;
    }
    if (!add(viewOf(reading.run, at), result)) {
        return false;
    }
    reading.run = replace(*name, behind, reading.end, reading.place, result);
    if (reading.run == nullptr) {
        return false;
    }
    reading.places.resume(reading.run);
    return true;
}

// Returns where replacements in a text at this place stand.
TextExpander::Place TextExpander::within(Place place) noexcept {
    return place == Place::Replacement ? Place::Replacement : Place::WithinArgument;
}

// Tells whether a macro's name stays as it is.
bool TextExpander::stays(const MacroName& name, const char* behind, const char* end,
                         Place place) const {
    if (place == Place::WithinArgument) {
        return false;
    }
    if (isAround(name)) {
        return true;
    }
    if (!name.macro.functionLike()) {
        return false;
    }
    return behind == end ? place == Place::Argument : *behind != '(' && !isBlankByte(*behind);
}

// Adds what a macro is replaced by, and returns the end of what it took of the text.
const char* TextExpander::replace(const MacroName& name, const char* behind, const char* end,
                                  Place place, Result& result) {
    if ((mayBeRefreshed(name) && isRefreshed(name)) || isAround(name)) {
        return nullptr;
    }
    if (!name.macro.functionLike()) {
        around_.push_back(&name);
        const bool isTold = read(name.macro.text(), kNoParts, within(place), result);
        around_.pop_back();
        return isTold ? behind : nullptr;
    }
    const char* const open = skipBlankBytes(behind, end);
    return open < end && *open == '(' ? replaceCall(name, open, end, place, result) : nullptr;
}

const char* TextExpander::replaceCall(const MacroName& name, const char* open, const char* end,
                                      Place place, Result& result) {
    const std::size_t argumentsBefore = arguments_.size();
    const std::size_t buffersBefore = buffersUsed_;
    const std::size_t count = name.macro.parameterCount();
    const char* const behind =
        takeArgumentTexts(open, end, macros_.filter(), outline_, {arguments_.extend(count), count});
    if (behind == nullptr) {
        return nullptr;
    }
    work_ += static_cast<std::size_t>(behind - open);
    const MacroBody& body = bodies_.bodyOf(name.macro);
    if (!body.isPlain || !addReplacement(name, body, argumentsBefore, place, result)) {
        return nullptr;
    }
    arguments_.truncate(argumentsBefore);
    buffersUsed_ = buffersBefore;
    return behind;
}

// Adds what the call of a macro with these arguments is replaced by.
bool TextExpander::addReplacement(const MacroName& name, const MacroBody& body,
                                  std::size_t firstArgument, Place place, Result& result) {
    if (!watches_ && !hasMacros(body)) {
        const std::size_t before = result.text.size();
        if (addSettled(body, firstArgument, result)) {
            return true;
        }
        result.text.truncate(before);
    }
    Result replacement{takeBuffer()};
    if (!substitute(body, firstArgument, replacement)) {
        return false;
    }
    TextBuffer& text = replacement.text;
    if (text.isSettled()) {
        return add(text.view(), result);
    }
    around_.push_back(&name);
    const bool isTold = read(text.view(), text.settled(), within(place), result);
    around_.pop_back();
    return isTold;
}

bool TextExpander::substitute(const MacroBody& body, std::size_t firstArgument, Result& result) {
    for (const BodyStep& step : body.steps) {
        const std::size_t before = result.text.size();
        result.hasMacros = hasMacros(body, step);
        if (!addStep(body, step, firstArgument, result)) {
            return false;
        }
        if (!result.hasMacros) {
            result.text.settleFrom(before);
        }
    }
    return true;
}

// Adds a replacement to what it becomes part of, without reading it again. Returns false if names
// of macros are left in it, or if it is not told.
bool TextExpander::addSettled(const MacroBody& body, std::size_t firstArgument, Result& result) {
    Result replacement{result.text, result.isWritten};
    for (const BodyStep& step : body.steps) {
        const std::string_view* const text = textOf(step, firstArgument);
        const bool isAdded = text != nullptr ? addCounted(*text, replacement)
                                             : addStep(body, step, firstArgument, replacement);
        if (!isAdded || replacement.hasMacros) {
            return false;
        }
    }
    return true;
}

// Adds what a step yields, and notes whether names of macros are left in an argument of it, or in
// what was joined.
bool TextExpander::addStep(const MacroBody& body, const BodyStep& step, std::size_t firstArgument,
                           Result& result) {
    switch (step.kind) {
    case BodyStep::Kind::Tokens: return addCounted(step.text, result);
    case BodyStep::Kind::Argument: return addArgument(firstArgument + step.first, result);
    case BodyStep::Kind::Joined: return addJoined(body, step, firstArgument, result);
    default: return false;
    }
}

// Returns the text that a step yields as it stands if no names are watched; null if there is none.
inline const std::string_view* TextExpander::textOf(const BodyStep& step,
                                                    std::size_t firstArgument) const {
    if (step.kind == BodyStep::Kind::Argument) {
        const ArgumentText& argument = arguments_[firstArgument + step.first];
        return argument.mayHaveMacros ? nullptr : &argument.raw;
    }
    return step.kind == BodyStep::Kind::Tokens ? &step.text : nullptr;
}

// Adds what an argument comes out as.
bool TextExpander::addArgument(std::size_t argument, Result& result) {
    if (!arguments_[argument].mayHaveMacros && !watches_) {
        return addCounted(arguments_[argument].raw, result);
    }
    if (arguments_[argument].expansion.data() == nullptr) {
        Result expansion{takeBuffer()};
        if (!read(arguments_[argument].raw, kNoParts, Place::Argument, expansion)) {
            return false;
        }
        arguments_[argument].expansion = expansion.text.view();
        arguments_[argument].hasMacros = expansion.hasMacros;
    }
    result.hasMacros = result.hasMacros || arguments_[argument].hasMacros;
    return addCounted(arguments_[argument].expansion, result);
}

bool TextExpander::addJoined(const MacroBody& body, const BodyStep& step, std::size_t firstArgument,
                             Result& result) {
    const std::size_t before = result.text.size();
    const ArgumentText* const arguments = arguments_.data() + firstArgument;
    const bool isLiteral = OperandJoin::isLiteral(body, step, arguments);
    const bool isAdded = join_.join(body, step, arguments, kMostWork - work_, result.text);
    const std::string_view whole = result.text.view();
    const std::string_view text = viewOf(whole.data() + before, whole.data() + whole.size());
    if (!isAdded || isTooMuch(text.size()) || meets(before, result)) {
        return false;
    }
    return isLiteral || isPlain(text, result.hasMacros);
}

// Tells whether a joined text yields tokens of text only, and notes whether there are names of
// macros among them.
bool TextExpander::isPlain(std::string_view text, bool& hasMacros) {
    const char* const end = text.data() + text.size();
    const char* at = text.data();
    while (at != nullptr && at < end) {
        if (isNameStart(*at)) {
            const char* const behind = nameEndAhead(at);
            hasMacros = hasMacros || macroOf(viewOf(at, behind)) != nullptr;
            at = behind;
        } else {
            at = unusualTokenEnd(at, end);
        }
    }
    return at != nullptr;
}

// Tells whether the bytes that meet where something was added may belong to one token.
[[gnu::always_inline]] inline bool TextExpander::meets(std::size_t before, const Result& result) {
    const TextBuffer& text = result.text;
    return !result.isWritten && before > 0 && before < text.size()
           && mayMeet(text[before - 1], text[before]);
}

// Adds a text, unless the bytes that meet there may belong to one token.
[[gnu::always_inline]] inline bool TextExpander::add(std::string_view text, Result& result) {
    const std::size_t before = result.text.size();
    result.text.append(text);
    return !meets(before, result);
}

// The same for a part of a replacement.
[[gnu::always_inline]] inline bool TextExpander::addCounted(std::string_view text, Result& result) {
    return !isTooMuch(text.size()) && add(text, result);
}

// Counts bytes that are written, and tells whether they were too many.
bool TextExpander::isTooMuch(std::size_t bytes) {
    work_ += bytes;
    return work_ > kMostWork;
}

// Tells whether the tokens of a body hold names of macros.
bool TextExpander::hasMacros(const MacroBody& body) const {
    if (body.changes != macros_.changes()) {
        const auto isMacro = [](const Name* name) { return name->isDefined; };
        body.hasMacros = std::any_of(body.names.begin(), body.names.end(), isMacro);
        body.changes = macros_.changes();
    }
    return body.hasMacros;
}

// Tells whether the tokens of a step hold names of macros.
bool TextExpander::hasMacros(const MacroBody& body, const BodyStep& step) {
    bool any = false;
    for (std::size_t index = step.firstName; index < step.lastName; ++index) {
        const Name& name = *body.names[index];
        if (watches_) {
            macros_.watch(name.text);
        }
        any = any || name.isDefined;
    }
    return any;
}

// Returns the macro of this name, or null.
inline const MacroName* TextExpander::macroOf(std::string_view name) {
    if (watches_) {
        macros_.watch(name);
    }
    return macros_.filter().mayHoldAmongBytes(name) && name != "defined" ? macros_.find(name)
                                                                         : nullptr;
}

// There are few names around, and std::find is made for many: `functions` takes 1 % less this way.
inline bool TextExpander::isAround(const MacroName& name) const {
    for (const MacroName* const one : around_) {
        if (one == &name) {
            return true;
        }
    }
    return false;
}

// Returns an empty text for use until the call that is replaced has been.
inline TextBuffer& TextExpander::takeBuffer() {
    if (buffersUsed_ == buffers_.size()) {
        buffers_.push_back(std::make_unique<TextBuffer>());
    }
    TextBuffer& buffer = *buffers_[buffersUsed_];
    ++buffersUsed_;
    buffer.clear();
    return buffer;
}

}  // namespace umpre
