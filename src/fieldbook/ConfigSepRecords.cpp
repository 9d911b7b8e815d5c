#include "fieldbook/ConfigSepRecords.h"

#include "core/AngleUnits.h"
#include "core/FileLines.h"
#include "core/Lines.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/Undefined.h"
#include "fieldbook/FieldBookReader.h"
#include "fieldbook/FieldBookTexts.h"
#include "geobase/Carnet.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cmath>

namespace pyr {

namespace {

enum class RecordKind { Station, Reference, Mesure, Point, Code, Comment };

// A kind of record: the word of its TYPE field, and where that field lies (in the list of the kind; codes
// and comments have theirs where the other records have it).
struct RecordKindWords {
    RecordKind kind;
    std::string_view word;
    const std::vector<FieldPlace>* fields;
    std::size_t typeIndex;
};

constexpr std::size_t kNoType = static_cast<std::size_t>(-1);
// No number that a field book writes is longer; a longer field is reported as no number.
constexpr std::size_t kLongestNumber = 63;
constexpr std::size_t kFieldCount = static_cast<std::size_t>(RecordField::Ignore) + 1;

std::size_t TypeIndex(const std::vector<FieldPlace>& fields) {
    for (std::size_t i = 0; i < fields.size(); ++i)
        if (fields[i].field == RecordField::Type) return i;
    return kNoType;
}

bool IsAngle(RecordField field) {
    return field == RecordField::AH || field == RecordField::AV || field == RecordField::V0;
}

// The values of one record: every number missing until a field gives it.
struct Values {
    std::string_view mat, code;
    std::array<double, kFieldCount> number;
    Values() { number.fill(kUndefined); }
    double operator[](RecordField field) const { return number[static_cast<std::size_t>(field)]; }
};

class RecordBuilder {
public:
    RecordBuilder(const RecordLayout& layout, RecordUnits units, CRecordFields& fields, CCarnet& records,
                  CPyrTxtWnd* txt);
    void ReadLine(std::string_view line, int number);

private:
    void Read(const RecordKindWords& kind, int line);
    bool ReadValues(const std::vector<FieldPlace>& list, int line, Values& values);
    bool ReadNumber(std::string_view text, RecordField field, int line, double& value) const;
    void Missing(int line, const char* datum) const;

    const RecordLayout& m_layout;
    RecordUnits m_units;
    CRecordFields& m_fields;
    CCarnet& m_records;
    CPyrTxtWnd* m_txt;
    std::vector<RecordKindWords> m_kinds; // the kinds that a TYPE field can name, in the order they are tried
    bool m_typed = false;
};

RecordBuilder::RecordBuilder(const RecordLayout& layout, RecordUnits units, CRecordFields& fields,
                             CCarnet& records, CPyrTxtWnd* txt)
    : m_layout(layout), m_units(units), m_fields(fields), m_records(records), m_txt(txt) {
    const std::vector<FieldPlace>* lists[] = {&layout.station, &layout.sighting, &layout.point};
    auto add = [this](RecordKind kind, const std::string& word, const std::vector<FieldPlace>& list) {
        const std::size_t type = TypeIndex(list);
        if (type == kNoType) return;
        m_typed = true;
        if (!Trimmed(word).empty()) m_kinds.push_back({kind, Trimmed(word), &list, type});
    };
    add(RecordKind::Station, layout.typeStation, layout.station);
    add(RecordKind::Reference, layout.typeReference, layout.sighting);
    add(RecordKind::Mesure, layout.typeMesure, layout.sighting);
    add(RecordKind::Point, layout.typePoint, layout.point);
    // Codes and comments carry their type where the points do (else the sightings, else the stations),
    // and their text after it.
    for (const auto* list : {lists[2], lists[1], lists[0]}) {
        if (TypeIndex(*list) == kNoType) continue;
        add(RecordKind::Code, layout.typeCode, *list);
        add(RecordKind::Comment, layout.typeComment, *list);
        break;
    }
}

void RecordBuilder::ReadLine(std::string_view line, int number) {
    if (number <= m_layout.headerLines || Trimmed(line).empty()) return;
    m_fields.Split(line);
    if (!m_typed) {
        // Without a TYPE field, the file is a list of points.
        if (m_layout.point.empty()) {
            if (m_txt) m_txt->Print(fb::kUnrecognised, number);
            return;
        }
        static constexpr RecordKindWords kPoint{RecordKind::Point, {}, nullptr, kNoType};
        Read(kPoint, number);
        return;
    }
    for (const RecordKindWords& kind : m_kinds) {
        const FieldPlace& type = (*kind.fields)[kind.typeIndex];
        if (EqualIgnoringCase(m_fields.Field(type, kind.typeIndex), kind.word)) {
            Read(kind, number);
            return;
        }
    }
    if (m_txt) m_txt->Print(fb::kUnrecognised, number);
}

void RecordBuilder::Read(const RecordKindWords& kind, int line) {
    if (kind.kind == RecordKind::Code || kind.kind == RecordKind::Comment) {
        const std::string_view text = m_fields.After((*kind.fields)[kind.typeIndex], kind.typeIndex);
        if (kind.kind == RecordKind::Comment) {
            m_records.Add(std::make_unique<CComment>(std::string(text)), kKindComment);
        } else if (text.empty()) {
            Missing(line, fb::kDatumFieldCode);
        } else {
            m_records.Add(std::make_unique<CCommande>(std::string(text)), kKindCommand);
        }
        return;
    }
    const std::vector<FieldPlace>& list = kind.kind == RecordKind::Station ? m_layout.station
                                          : kind.kind == RecordKind::Point ? m_layout.point
                                                                           : m_layout.sighting;
    Values v;
    if (!ReadValues(list, line, v)) return;
    if (v.mat.empty())
        return Missing(line, kind.kind == RecordKind::Station ? fb::kDatumStationName : fb::kDatumPointName);
    if (const std::size_t extra = m_fields.Extra(list.size()); extra > 0 && m_txt)
        m_txt->Print(fb::kExtraFields, line, static_cast<int>(extra));
    std::string mat(v.mat), code(v.code);
    using enum RecordField;
    switch (kind.kind) {
    case RecordKind::Station:
        m_records.Add(std::make_unique<CStation>(std::move(mat), v[HI], v[V0], std::move(code)),
                      kKindStation);
        break;
    case RecordKind::Reference:
        m_records.Add(
            std::make_unique<CReference>(std::move(mat), v[HP], v[AH], v[AV], v[DI], std::move(code)),
            kKindReference);
        break;
    case RecordKind::Mesure:
        m_records.Add(std::make_unique<CMesure>(std::move(mat), v[HP], v[AH], v[AV], v[DI], std::move(code)),
                      kKindMesure);
        break;
    default:
        m_records.Add(std::make_unique<CPointGen>(std::move(mat), v[X], v[Y], v[Z], std::move(code)),
                      kKindPoint);
        break;
    }
}

bool RecordBuilder::ReadValues(const std::vector<FieldPlace>& list, int line, Values& values) {
    for (std::size_t i = 0; i < list.size(); ++i) {
        const RecordField field = list[i].field;
        if (field == RecordField::Type || field == RecordField::Ignore) continue;
        const std::string_view text = m_fields.Field(list[i], i);
        if (field == RecordField::Matricule)
            values.mat = text;
        else if (field == RecordField::Code)
            values.code = text;
        else if (!ReadNumber(text, field, line, values.number[static_cast<std::size_t>(field)]))
            return false;
    }
    return true;
}

// An empty field is a value that was not measured; so is the undefined value written out (-999999).
bool RecordBuilder::ReadNumber(std::string_view text, RecordField field, int line, double& value) const {
    value = kUndefined;
    if (text.empty()) return true;
    char buffer[kLongestNumber];
    const bool fits = text.size() <= kLongestNumber;
    std::string_view number;
    if (fits) {
        std::copy(text.begin(), text.end(), buffer);
        if (m_layout.decimal == ',') std::replace(buffer, buffer + text.size(), ',', '.');
        number = std::string_view(buffer, text.size());
    }
    double read = 0.0;
    bool good = fits && ParseDouble(number, read) && std::isfinite(read);
    if (good && IsKnown(read) && IsAngle(field)) {
        // Degrees, minutes and seconds are taken from the digits as written, never from a rounded double.
        good = AngleTextToGrads(number, m_units.angles, read);
    } else if (good && IsKnown(read)) {
        read = ToMetres(read, m_units.distances);
    }
    if (!good) {
        if (m_txt) m_txt->Print(fb::kBadNumber, line, std::string(text).c_str());
        return false;
    }
    value = read;
    return true;
}

void RecordBuilder::Missing(int line, const char* datum) const {
    if (m_txt) m_txt->Print(fb::kMissingDatum, line, datum);
}

} // namespace

void ImportRecords(const RecordLayout& layout, RecordUnits units, std::string_view text,
                   CRecordFields& fields, CCarnet& records, CPyrTxtWnd* txt) {
    RecordBuilder builder(layout, units, fields, records, txt);
    ForEachLine(text, [&](std::string_view line, int number) {
        if (txt && IsCutLastLine(text, line)) txt->PrintText(Sprintf(fb::kCutLastLine, number));
        builder.ReadLine(line, number);
    });
}

void ImportRecords(const CParamDriver& layout, std::string_view text, CRecordFields& fields, CCarnet& records,
                   CPyrTxtWnd* txt) {
    ImportRecords(layout.Layout(), {layout.Angles(), layout.Distances()}, text, fields, records, txt);
}

bool ImportRecordFile(const CParamDriver& layout, const std::string& carnet, CRecordFields& fields,
                      CCarnet& records, CPyrTxtWnd* txt, ui::FrontEnd* parent, const RecordDrain& drain) {
    // A batch small enough to stay in the processor's caches, its elements' memory used again by the next.
    constexpr int kBatch = 4096;
    FileLines file;
    const RecordLayout recordLayout = layout.Layout(); // the builder reads it to the end
    RecordBuilder builder(recordLayout, {layout.Angles(), layout.Distances()}, fields, records, txt);
    const bool read =
        file.Open(carnet) && file.ForEach(
                                 [&](const FileLines::Line& line) {
                                     if (txt && line.unterminated && !TrimmedOfControls(line.text).empty())
                                         txt->PrintText(Sprintf(fb::kCutLastLine, line.number));
                                     builder.ReadLine(line.text, line.number);
                                     if (drain && records.GetSize() >= kBatch) drain(records);
                                 },
                                 [&] {
                                     if (txt) txt->Print(fb::kReadAsWindows1252, carnet.c_str());
                                 });
    if (!read) {
        const int code = errno;
        ui::FrontEnd& frontEnd = parent ? *parent : ui::ApplicationFrontEnd();
        frontEnd.MessageBox(CarnetOpenFailure(carnet, code), ui::kCaption, ui::kIconWarning);
        return false;
    }
    return true;
}

} // namespace pyr
