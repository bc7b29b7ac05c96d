// SPDX-License-Identifier: MIT
//
// Where a source is little more than a list of files, to find its lines is most of the work. A line
// is therefore looked at as one block, whatever its size.
#include "directives/known_lines.h"

#include <algorithm>
#include <cstring>

#include "lex/byte_block.h"

namespace umpre {
namespace {

// What a line that is kept begins with, and the least that it has behind that.
constexpr std::string_view kBegin = "#include";
constexpr std::size_t kRest = 4;
constexpr std::size_t kFewestSlots = 256;

[[nodiscard]] std::uint64_t chunkAt(const char* at) noexcept {
    std::uint64_t chunk = 0;
    std::memcpy(&chunk, at, sizeof chunk);
    return chunk;
}

}  // namespace

void KnownLines::keep(std::string_view text, Search& search, std::size_t macroNames) {
    const std::string_view line = text.substr(0, sizeOfLine(text));
    if (line.empty()) {
        return;
    }
    if (4 * lines_.size() >= slots_.size()) {
        makeRoom();
    }
    const std::uint32_t hash = hashOf(line);
    Slot& slot = slots_[slotOf(line, hash)];
    if (slot.number == 0) {
        lines_.push_back({Snippet(line), nullptr, 0, {}});
        slot = {hash, static_cast<std::uint32_t>(lines_.size())};
    }
    Line& known = lines_[slot.number - 1];
    known.search = &search;
    known.macroNames = macroNames;
    known.passage = {};
}

KnownLines::Line* KnownLines::find(std::string_view text) noexcept {
    const std::string_view line = text.substr(0, sizeOfLine(text));
    if (line.empty() || slots_.empty()) {
        return nullptr;
    }
    const std::uint32_t number = slots_[slotOf(line, hashOf(line))].number;
    return number == 0 ? nullptr : &lines_[number - 1];
}

// Returns the size of the line that a text begins with; 0 if it is none that can be kept.
std::size_t KnownLines::sizeOfLine(std::string_view text) noexcept {
    if (text.size() < kBegin.size() || chunkAt(text.data()) != chunkAt(kBegin.data())) {
        return 0;
    }
    const ByteBlock::Mask lineEnds = ByteBlock(text.data()).any('\n') & bitsBelow(text.size());
    const std::size_t size = lineEnds == 0 ? 0 : firstBit(lineEnds) + 1;
    return size < kBegin.size() + kRest ? 0 : size;
}

// Of the bytes behind the first word and the last ones, which may be the same.
std::uint32_t KnownLines::hashOf(std::string_view line) noexcept {
    constexpr std::uint64_t kFactor = 0x9E3779B97F4A7C15U;
    constexpr std::size_t kChunk = sizeof(std::uint64_t);
    const std::size_t last = line.size() - kChunk;
    const std::uint64_t first = chunkAt(line.data() + std::min(kBegin.size() + 1, last));
    const std::uint64_t middle = chunkAt(line.data() + (last - std::min(last, kChunk)));
    const std::uint64_t sum = (chunkAt(line.data() + last) ^ line.size()) * kFactor
                              + (first ^ first >> 31U) * (kFactor << 1U | 1U)
                              + (middle ^ middle >> 33U) * (kFactor << 2U | 1U);
    return static_cast<std::uint32_t>(sum >> 32U);
}

// Returns the slot of this line, or the free one for it.
std::size_t KnownLines::slotOf(std::string_view line, std::uint32_t hash) const noexcept {
    const std::size_t mask = slots_.size() - 1;
    const auto isFound = [&](const Slot& slot) {
        return slot.number == 0
               || (slot.hash == hash && lines_[slot.number - 1].text.standsAt(line.data()));
    };
    std::size_t slot = hash & mask;
    while (!isFound(slots_[slot])) {
        slot = (slot + 1) & mask;
    }
    return slot;
}

// Doubles the slots. When there are very many, it forgets the lines instead.
void KnownLines::makeRoom() {
    if (slots_.size() == kMostSlots) {
        lines_.clear();
    }
    std::vector<Slot> before(std::clamp(2 * slots_.size(), kFewestSlots, kMostSlots));
    before.swap(slots_);
    for (std::size_t number = 0; number < lines_.size(); ++number) {
        const std::string_view line = lines_[number].text.text();
        const std::uint32_t hash = hashOf(line);
        slots_[slotOf(line, hash)] = {hash, static_cast<std::uint32_t>(number + 1)};
    }
}

}  // namespace umpre
