#pragma once

#include <span>
#include <string>
#include <string_view>
#include <vector>

// The instruments of the options, in the section "Définitions_Des_Appareils": one numbered group of keys
// per instrument, "Appareil%d" for its name and six numbered values.
//
// Numbering: an instrument's number is its position in the list, counted from 0. The list always starts
// with the standard instrument "Appareil Standard" (number 0), whether the file holds it or not. Reading
// goes from "Appareil0" (or "Appareil1" when there is no "Appareil0": a list numbered from 1 by hand)
// upwards and stops at the first number whose name is missing or empty; writing
// numbers the list again from 0 and empties the name that follows the last instrument, so that an
// instrument removed from the list is not read back.
namespace pyr {

struct InstrumentOptions {
    std::string name;
    double prismConstant = 0;       // metres, "ConstPrisme%d"
    double verticalCollimation = 0; // grads, "CollVerticale%d"
    double sigmaAh = 0;             // grads, precision of horizontal directions, "SigmaAh%d"
    double sigmaAv = 0;             // grads, precision of zenith angles, "SigmaAv%d"
    double sigmaDi = 0;             // metres, constant part of the distance precision, "SigmaDi%d"
    double sigmaPpm = 0;            // parts per million (mm/km) of the distance, "SigmaPpm%d"

    bool operator==(const InstrumentOptions&) const = default;
};

inline constexpr const char* kInstrumentNameKey = "Appareil";

// One numbered value of an instrument: the key without its number, the limits, the member.
struct InstrumentValueKey {
    const char* prefix; // "ConstPrisme"
    double minimum;
    double maximum;
    double InstrumentOptions::*member;
};
std::span<const InstrumentValueKey> InstrumentValueKeys();

// "SigmaAh3": the key's prefix ("SigmaAh", or kInstrumentNameKey for a name) and its number 3. False for
// a key of another form (no number, a sign, other characters after the digits).
bool SplitInstrumentKey(std::string_view key, std::string& prefix, int& number);

// The list of instruments: the standard one first (with the values the file gives it, if any), then the
// others in the order of their numbers, every value brought within its limits.
std::vector<InstrumentOptions> ReadInstruments(std::string_view paramPath);

// Writes one instrument's name and values under that number ("%f" for the values).
bool WriteInstrument(std::string_view paramPath, int number, const InstrumentOptions& instrument);
// Writes the whole list, numbered from 0, and ends it in the file.
bool WriteInstruments(std::string_view paramPath, const std::vector<InstrumentOptions>& instruments);
// Empties the name of instrument `number` when the file holds one, so that a read stops there.
bool EndInstrumentList(std::string_view paramPath, int number);

} // namespace pyr
