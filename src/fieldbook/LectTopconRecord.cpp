#include "fieldbook/LectTopconRecord.h"

#include "core/Strings.h"

namespace pyr::topcon {

namespace {

struct KeywordName {
    std::string_view name;
    Keyword kind;
};

// The sightings and observations first: they make most of the lines of a field book.
constexpr KeywordName kKeywords[] = {
    {"SS", Keyword::SideSighting},  {"SD", Keyword::SlopeDistance}, {"HV", Keyword::AnglesOnly},
    {"HD", Keyword::Horizontal},    {"FS", Keyword::ForeSighting},  {"BS", Keyword::BackSighting},
    {"STN", Keyword::Station},      {"XYZ", Keyword::Position},     {"BKB", Keyword::Backsight},
    {"NOTE", Keyword::Note},        {"OFFSET", Keyword::Offset},    {"JOB", Keyword::Job},
    {"DATE", Keyword::Date},        {"NAME", Keyword::Name},        {"INST", Keyword::Instrument},
    {"UNITS", Keyword::Units},      {"SCALE", Keyword::Scale},      {"ATMOS", Keyword::Atmosphere},
    {"TEMP", Keyword::Temperature}, {"CTL", Keyword::Control},
};

Keyword Recognise(std::string_view keyword) {
    for (const KeywordName& known : kKeywords)
        if (keyword.size() == known.name.size() && EqualIgnoringCase(keyword, known.name)) return known.kind;
    return Keyword::Unknown;
}

} // namespace

void SplitRecord(std::string_view line, Record& record) {
    std::size_t end = 0;
    while (end < line.size() && line[end] != ' ' && line[end] != '\t')
        ++end;
    record.keyword = line.substr(0, end);
    record.kind = Recognise(record.keyword);
    record.values = Trimmed(line.substr(end));
    record.count = 0;
    if (record.values.empty()) return;
    std::string_view rest = record.values;
    while (record.count < kMaxFields) {
        const std::size_t comma = rest.find(',');
        record.fields[record.count++] = Trimmed(rest.substr(0, comma));
        if (comma == std::string_view::npos) break;
        rest.remove_prefix(comma + 1);
    }
}

} // namespace pyr::topcon
