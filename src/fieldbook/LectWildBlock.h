#pragma once

#include "core/Undefined.h"
#include "fieldbook/LectWildValues.h"
#include "fieldbook/LectWildWord.h"

#include <array>
#include <string_view>

// What one GSI block says, its words read into grads and metres: the interpretation of a block's words,
// before the reader turns them into the elements of a GéoBase.
namespace pyr::gsi {

// A levelling staff reading (words 330 to 336).
struct StaffReading {
    int index = 0; // 331 and 335 back readings, 330 332 333 336 fore readings
    double metres = 0.0;
};

// At most that many staff readings and unknown words are kept of a block; beyond, they are dropped.
inline constexpr std::size_t kMaxNoted = 8;

// What a block gives. Reset before each block; the lists hold their first kMaxNoted entries.
struct BlockContent {
    bool codeBlock = false; // a block of word 41

    // ---- Ids and texts, as written (WordText drops their padding); empty when not given
    std::string_view point;   // 11
    std::string_view station; // 16: the station's point id
    std::string_view code;    // 41: the code of a code block
    // 71 to 79, the point's code and attributes, and 42 to 49, the information of a code block: the
    // words in the order of the block.
    std::array<const Word*, kMaxNoted> remarks;
    std::size_t remarkCount = 0;
    std::array<const Word*, kMaxNoted> infos;
    std::size_t infoCount = 0;

    // ---- Values in grads and metres, kUndefined when not given or given as missing
    double hz = kUndefined;               // 21 horizontal circle reading
    double v = kUndefined;                // 22 vertical (zenith) angle
    double slope = kUndefined;            // 31 slope distance
    double horizontal = kUndefined;       // 32 horizontal distance
    double heightDifference = kUndefined; // 33 from the tilting axis to the target
    double east = kUndefined, north = kUndefined, elevation = kUndefined; // 81 82 83 the target
    double stationEast = kUndefined, stationNorth = kUndefined, stationElevation = kUndefined; // 84 85 86
    double reflector = kUndefined;  // 87 reflector height
    double instrument = kUndefined; // 88 instrument height

    // ---- Header information and the instrument's constants
    std::string_view serial;                       // 12
    std::string_view type;                         // 13
    std::string_view date;                         // 17 DDMMYYYY
    std::string_view dateTime;                     // 19 MMDDhhmm
    double ppm = kUndefined, prismMm = kUndefined; // 51
    double prismConstantMm = kUndefined;           // 58
    double ppmTotal = kUndefined;                  // 59

    // ---- Levelling
    std::array<StaffReading, kMaxNoted> readings;
    std::size_t readingCount = 0;

    // ---- What the reader may want to say about the block's words
    std::array<int, kMaxNoted> unknown; // word indices this reader does not know
    std::size_t unknownCount = 0;
    const Word* foreignUnit = nullptr; // a word with a unit digit of the other kind

    // Everything back to "not given" (the lists are emptied, not cleared).
    void Reset();

    // The information word of that index (42 to 49), or null.
    const Word* Info(int index) const;
    bool HasObservation() const;
    bool HasTarget() const;          // 81, 82 or 83
    bool HasStationWords() const;    // 84, 85, 86 or 88
    bool HasStationPosition() const; // 84, 85 or 86
    bool HasRemarks() const { return remarkCount > 0; }
};

// Reads the words of a block. False when a word's data is no number: `bad` then names it.
bool ReadBlock(const Block& block, const Units& units, BlockContent& content, const Word*& bad);

} // namespace pyr::gsi
