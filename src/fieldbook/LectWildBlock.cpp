#include "fieldbook/LectWildBlock.h"

namespace pyr::gsi {

namespace {

// Decimals of the words that are no angle and no length, without a unit digit: ppm (59) in whole
// parts per million, the prism constant (58) in tenths of a millimetre.
constexpr int kPpmDecimals = 0;
constexpr int kPrismDecimals = 4; // as a length in metres: 0.1 mm

constexpr double kMillimetresPerMetre = 1000.0;

// Words read and known, that carry nothing a GéoBase keeps: the time's seconds (18), Hz0 - Hz (25), the
// offsets and second readings (26 to 28), the measurement counts and deviations (52 to 57), the
// set-out staff reading (334), the levelling differences and lengths (390s, 560 to 579).
bool IsUnused(int index) {
    return index == 18 || (index >= 25 && index <= 28) || (index >= 52 && index <= 57) || index == 334 ||
           (index >= 390 && index <= 399) || (index >= 560 && index <= 579);
}

bool IsStaffReading(int index) {
    return index >= 330 && index <= 336 && index != 334;
}

void NoteForeignUnit(const Word& word, bool angle, BlockContent& content) {
    if (!word.unit || content.foreignUnit) return;
    if (angle ? !IsAngleUnit(word.unit) : !IsLengthUnit(word.unit)) content.foreignUnit = &word;
}

// A value, kUndefined when the word says it has none; false when it is no number.
bool Angle(const Word& word, const Units& units, double& grads, BlockContent& content) {
    NoteForeignUnit(word, true, content);
    grads = kUndefined;
    return ReadAngle(word, units.angles, grads) != Value::Bad;
}

bool Length(const Word& word, const Units& units, double& metres, BlockContent& content) {
    NoteForeignUnit(word, false, content);
    metres = kUndefined;
    return ReadLength(word, units.distances, metres) != Value::Bad;
}

bool Scaled(const Word& word, int decimals, double& value) {
    value = kUndefined;
    return ReadScaled(word, decimals, value) != Value::Bad;
}

// What the two-digit words that hold one text or one value give: where it goes in the block.
struct Slot {
    enum Kind : char { None, Text, Angle, Length } kind = None;
    std::string_view BlockContent::*text = nullptr;
    double BlockContent::*value = nullptr;
};

const std::array<Slot, 100>& Slots() {
    static const std::array<Slot, 100> slots = [] {
        std::array<Slot, 100> table{};
        const auto text = [&](int index, std::string_view BlockContent::*member) {
            table[static_cast<std::size_t>(index)] = {Slot::Text, member, nullptr};
        };
        const auto value = [&](int index, Slot::Kind kind, double BlockContent::*member) {
            table[static_cast<std::size_t>(index)] = {kind, nullptr, member};
        };
        text(11, &BlockContent::point);
        text(12, &BlockContent::serial);
        text(13, &BlockContent::type);
        text(16, &BlockContent::station);
        text(17, &BlockContent::date);
        text(19, &BlockContent::dateTime);
        text(41, &BlockContent::code);
        value(21, Slot::Angle, &BlockContent::hz);
        value(22, Slot::Angle, &BlockContent::v);
        value(31, Slot::Length, &BlockContent::slope);
        value(32, Slot::Length, &BlockContent::horizontal);
        value(33, Slot::Length, &BlockContent::heightDifference);
        value(81, Slot::Length, &BlockContent::east);
        value(82, Slot::Length, &BlockContent::north);
        value(83, Slot::Length, &BlockContent::elevation);
        value(84, Slot::Length, &BlockContent::stationEast);
        value(85, Slot::Length, &BlockContent::stationNorth);
        value(86, Slot::Length, &BlockContent::stationElevation);
        value(87, Slot::Length, &BlockContent::reflector);
        value(88, Slot::Length, &BlockContent::instrument);
        return table;
    }();
    return slots;
}

// The words with more than one value, with a scale of their own, or kept in a list.
bool ReadOtherWord(const Word& word, const Units& units, BlockContent& c) {
    const int index = word.index;
    if (index == 51) {
        double ppm = kUndefined, prism = kUndefined;
        const Value value = ReadPpmAndPrism(word, ppm, prism);
        if (value == Value::Read) {
            c.ppm = ppm;
            c.prismMm = prism;
        }
        return value != Value::Bad;
    }
    if (index == 58) {
        double metres = kUndefined;
        if (!Scaled(word, kPrismDecimals, metres)) return false;
        c.prismConstantMm = IsKnown(metres) ? metres * kMillimetresPerMetre : kUndefined;
        return true;
    }
    if (index == 59) return Scaled(word, kPpmDecimals, c.ppmTotal);
    if (index >= 42 && index <= 49) {
        if (c.infoCount < kMaxNoted) c.infos[c.infoCount++] = &word;
    } else if (index >= 71 && index <= 79) {
        if (c.remarkCount < kMaxNoted) c.remarks[c.remarkCount++] = &word;
    } else if (IsStaffReading(index)) {
        double metres = kUndefined;
        if (!Length(word, units, metres, c)) return false;
        if (IsKnown(metres) && c.readingCount < kMaxNoted) c.readings[c.readingCount++] = {index, metres};
    } else if (!IsUnused(index) && c.unknownCount < kMaxNoted) {
        c.unknown[c.unknownCount++] = index;
    }
    return true;
}

bool ReadWord(const Word& word, const Units& units, BlockContent& c) {
    const Slot slot = word.index < 100 ? Slots()[static_cast<std::size_t>(word.index)] : Slot{};
    switch (slot.kind) {
    case Slot::Text:
        c.*slot.text = word.data;
        if (word.index == 41) c.codeBlock = true;
        return true;
    case Slot::Angle:
        return Angle(word, units, c.*slot.value, c);
    case Slot::Length:
        return Length(word, units, c.*slot.value, c);
    case Slot::None:
        break;
    }
    return ReadOtherWord(word, units, c);
}

} // namespace

bool BlockContent::HasObservation() const {
    return IsKnown(hz) || IsKnown(v) || IsKnown(slope) || IsKnown(horizontal) || IsKnown(heightDifference);
}

bool BlockContent::HasTarget() const {
    return IsKnown(east) || IsKnown(north) || IsKnown(elevation);
}

bool BlockContent::HasStationPosition() const {
    return IsKnown(stationEast) || IsKnown(stationNorth) || IsKnown(stationElevation);
}

bool BlockContent::HasStationWords() const {
    return HasStationPosition() || IsKnown(instrument);
}

// Every value of the struct but its lists, whose counts say what they hold: a block of a field book of a
// million lines does not clear them each time.
void BlockContent::Reset() {
    codeBlock = false;
    point = station = code = {};
    remarkCount = infoCount = readingCount = unknownCount = 0;
    hz = v = slope = horizontal = heightDifference = kUndefined;
    east = north = elevation = kUndefined;
    stationEast = stationNorth = stationElevation = kUndefined;
    reflector = instrument = kUndefined;
    serial = type = date = dateTime = {};
    ppm = prismMm = prismConstantMm = ppmTotal = kUndefined;
    foreignUnit = nullptr;
}

const Word* BlockContent::Info(int index) const {
    const Word* found = nullptr;
    for (std::size_t i = 0; i < infoCount; ++i)
        if (infos[i]->index == index) found = infos[i];
    return found;
}

bool ReadBlock(const Block& block, const Units& units, BlockContent& content, const Word*& bad) {
    content.Reset();
    for (const Word& word : block) {
        if (!ReadWord(word, units, content)) {
            bad = &word;
            return false;
        }
    }
    return true;
}

} // namespace pyr::gsi
