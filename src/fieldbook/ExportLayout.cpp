#include "fieldbook/ExportLayout.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "core/Undefined.h"
#include "fieldbook/ConfigCol.h"
#include "fieldbook/ConfigSep.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/FieldBookUnits.h"
#include "fieldbook/ParamDriver.h"
#include "geobase/Carnet.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstring>

namespace pyr {

namespace {

constexpr char kQuote = '"';
// What a field of a delimited line, or a text running to the end of a columnar line, rarely exceeds. The
// text of an export is reserved for lines that long, so that a million points are laid out without it
// being moved; the pages reserved and not written are never touched.
constexpr std::size_t kBytesPerField = 24;

const char* FieldWord(RecordField field) {
    switch (field) {
    case RecordField::Type:
        return "TYPE";
    case RecordField::Matricule:
        return "MATRICULE";
    case RecordField::X:
        return "X";
    case RecordField::Y:
        return "Y";
    case RecordField::Z:
        return "Z";
    case RecordField::Code:
        return "CODE";
    default:
        return "IGNORE"; // a point's list holds no other field
    }
}

bool IsCoordinate(RecordField field) {
    return field == RecordField::X || field == RecordField::Y || field == RecordField::Z;
}

double Coordinate(const CPointGen& point, RecordField field) {
    return field == RecordField::X ? point.x() : field == RecordField::Y ? point.y() : point.z();
}

bool Has(const std::vector<FieldPlace>& fields, RecordField field) {
    return std::any_of(fields.begin(), fields.end(),
                       [field](const FieldPlace& f) { return f.field == field; });
}

// The messages of the settings reader, which are failures of the export: the command that asked for it
// ends on a failure.
class FailureFrontEnd : public ui::FrontEnd {
public:
    explicit FailureFrontEnd(ui::FrontEnd& target) : m_target(target) {}
    void MessageBox(std::string_view text, std::string_view, int icon) override {
        m_target.ReportFailure(text, icon);
    }
    ui::Answer Ask(std::string_view text, std::string_view caption, ui::Buttons buttons, ui::Answer byDefault,
                   int icon) override {
        return m_target.Ask(text, caption, buttons, byDefault, icon);
    }
    std::optional<std::string> ChooseFile(const ui::FileChoice& choice) override {
        return m_target.ChooseFile(choice);
    }
    void TextLine(std::string_view line) override { m_target.TextLine(line); }
    ui::DialogResult DoModal(ui::Dialog& dialog) override { return m_target.DoModal(dialog); }
    void ShowFile(const std::string& path) override { m_target.ShowFile(path); }

private:
    ui::FrontEnd& m_target;
};

// Why the layout cannot write points that its reader reads back, and the key at fault; "" when it can.
std::string UnfitForPoints(const RecordLayout& layout, const char*& key) {
    key = kKeyChampsPoint;
    const std::vector<FieldPlace>& fields = layout.point;
    if (fields.empty()) return fb::kWhyExportNoPointFields;
    for (RecordField needed : {RecordField::Matricule, RecordField::X, RecordField::Y})
        if (!Has(fields, needed)) return Sprintf(fb::kWhyExportFieldMissing, FieldWord(needed));
    if (layout.columnar) {
        std::vector<FieldPlace> sorted = fields;
        std::stable_sort(sorted.begin(), sorted.end(),
                         [](const FieldPlace& a, const FieldPlace& b) { return a.first < b.first; });
        for (std::size_t i = 1; i < sorted.size(); ++i)
            if (sorted[i - 1].last == 0 || sorted[i - 1].last >= sorted[i].first)
                return Sprintf(fb::kWhyExportFieldsOverlap, FieldWord(sorted[i - 1].field),
                               FieldWord(sorted[i].field));
    }
    const auto type = std::find_if(fields.begin(), fields.end(),
                                   [](const FieldPlace& f) { return f.field == RecordField::Type; });
    if (type == fields.end()) return {};
    // The reader tries the stations' and the sightings' words before the points' one.
    key = kKeyTypePoint;
    const std::string_view word = Trimmed(layout.typePoint);
    if (word.empty()) return fb::kWhyExportEmptyType;
    const struct {
        const std::vector<FieldPlace>& list;
        const std::string& word;
        const char* key;
    } earlier[] = {{layout.station, layout.typeStation, kKeyTypeStation},
                   {layout.sighting, layout.typeReference, kKeyTypeReference},
                   {layout.sighting, layout.typeMesure, kKeyTypeMesure}};
    for (const auto& kind : earlier)
        if (Has(kind.list, RecordField::Type) && EqualIgnoringCase(Trimmed(kind.word), word))
            return Sprintf(fb::kWhyExportTypeTaken, std::string(word).c_str(), kind.key);
    if (layout.columnar && type->last > 0 &&
        Utf8Length(word) > static_cast<std::size_t>(type->last - type->first + 1))
        return Sprintf(fb::kWhyExportTypeTooLong, std::string(word).c_str(), type->first, type->last);
    return {};
}

// What keeps a point from any line: no identifier, a text that would break the line, a coordinate that is
// no finite number.
bool Writable(const CPointGen& point, std::string& why) {
    if (point.mat().empty()) {
        why = fb::kWhyNoIdentifier;
        return false;
    }
    if (point.mat().find_first_of("\r\n") != std::string::npos ||
        point.sym().find_first_of("\r\n") != std::string::npos) {
        why = fb::kWhyLineEndInText;
        return false;
    }
    for (RecordField field : {RecordField::X, RecordField::Y, RecordField::Z}) {
        const double value = Coordinate(point, field);
        if (IsKnown(value) && !std::isfinite(value)) {
            why = Sprintf(fb::kWhyCoordinateTooLarge, FieldWord(field), "pas un nombre fini");
            return false;
        }
    }
    return true;
}

void UseDecimalComma(std::string& out, std::size_t from) {
    std::replace(out.begin() + static_cast<std::ptrdiff_t>(from), out.end(), '.', ',');
}

// ---- Delimited lines: the fields in the order of the list, joined by the separator.
class DelimitedWriter {
public:
    DelimitedWriter(const RecordLayout& layout, DistanceUnit unit)
        : m_layout(layout), m_separator(layout.separator), m_type(Trimmed(layout.typePoint)),
          m_blanks(std::all_of(m_separator.begin(), m_separator.end(), [](char c) { return c == ' '; })),
          m_metresPerUnit(unit == DistanceUnit::Feet ? kMetresPerFoot : 1.0) {
        // A separator made of what numbers are made of ("." with the decimal point, "," with the comma,
        // a digit) would split them: they are then quoted like texts.
        m_numbersCheck = m_separator.find_first_of("0123456789-.,") != std::string::npos;
    }

    void AppendHeader(std::string& out, int lines) const {
        for (int line = 1; line < lines; ++line)
            out += '\n';
        if (lines <= 0) return;
        for (std::size_t i = 0; i < m_layout.point.size(); ++i) {
            if (i > 0) out += m_separator;
            out += FieldWord(m_layout.point[i].field);
        }
        out += '\n';
    }

    std::size_t LineEstimate() const { return (m_layout.point.size() + 1) * kBytesPerField; }

    bool AppendPoint(std::string& out, const CPointGen& point, std::string&) const {
        const std::size_t start = out.size();
        std::size_t filled = start; // after the last field that holds something
        for (std::size_t i = 0; i < m_layout.point.size(); ++i) {
            if (i > 0) out += m_separator;
            const RecordField field = m_layout.point[i].field;
            bool wrote = false;
            if (field == RecordField::Type)
                wrote = AppendText(out, m_type);
            else if (field == RecordField::Matricule)
                wrote = AppendText(out, point.mat());
            else if (field == RecordField::Code)
                wrote = AppendText(out, point.sym());
            else if (IsCoordinate(field))
                wrote = AppendNumber(out, Coordinate(point, field));
            if (wrote)
                filled = out.size();
            else if (m_blanks)
                out += "\"\""; // blanks cannot enclose an empty field: quotes do
        }
        // Fields missing at the end of a line are empty fields: blanks need no quotes for them.
        if (m_blanks) out.resize(filled);
        out += '\n';
        return true;
    }

private:
    // Whether the reader would not find the text whole: it holds a quote, or the separator starts within
    // it (a multi-character separator may start at its end: "a |" before " | "), or blanks with blanks.
    bool NeedsQuotes(std::string_view text) const {
        if (text.find(kQuote) != std::string_view::npos) return true;
        if (m_blanks) return text.find_first_of(" \t") != std::string_view::npos;
        if (m_separator.size() == 1) return text.find(m_separator[0]) != std::string_view::npos;
        for (std::size_t p = 0; p < text.size(); ++p) {
            std::size_t k = 0;
            for (; k < m_separator.size(); ++k) {
                const std::size_t at = p + k;
                const char c = at < text.size() ? text[at] : m_separator[at - text.size()];
                if (c != m_separator[k]) break;
            }
            if (k == m_separator.size()) return true;
        }
        return false;
    }

    // Quoted as spreadsheets write it, a quote inside doubled.
    static void AppendQuoted(std::string& out, std::string_view text) {
        out += kQuote;
        for (char c : text) {
            if (c == kQuote) out += kQuote;
            out += c;
        }
        out += kQuote;
    }

    bool AppendText(std::string& out, std::string_view text) const {
        if (text.empty()) return false;
        if (NeedsQuotes(text))
            AppendQuoted(out, text);
        else
            out += text;
        return true;
    }

    // Every digit the GéoBase holds: the shortest text that reads back as the same double.
    bool AppendNumber(std::string& out, double value) const {
        if (!IsKnown(value)) return false;
        const std::size_t at = out.size();
        AppendShortest(out, value / m_metresPerUnit);
        if (m_layout.decimal == ',') UseDecimalComma(out, at);
        if (m_numbersCheck && NeedsQuotes(std::string_view(out).substr(at))) {
            const std::string number = out.substr(at);
            out.resize(at);
            AppendQuoted(out, number);
        }
        return true;
    }

    const RecordLayout& m_layout;
    const std::string& m_separator;
    std::string_view m_type;
    bool m_blanks;
    bool m_numbersCheck = false;
    double m_metresPerUnit;
};

// ---- Columnar lines: each field at its columns, counted in characters from 1.
class ColumnarWriter {
public:
    ColumnarWriter(const RecordLayout& layout, DistanceUnit unit)
        : m_layout(layout), m_fields(layout.point), m_type(Trimmed(layout.typePoint)),
          m_metresPerUnit(unit == DistanceUnit::Feet ? kMetresPerFoot : 1.0) {
        // The fields may be listed in any order: a line is laid out from its first column.
        std::stable_sort(m_fields.begin(), m_fields.end(),
                         [](const FieldPlace& a, const FieldPlace& b) { return a.first < b.first; });
        m_number.reserve(64);
    }

    // The names of the fields at their columns, each cut to its field.
    void AppendHeader(std::string& out, int lines) const {
        for (int line = 1; line < lines; ++line)
            out += '\n';
        if (lines <= 0) return;
        std::size_t column = 1;
        for (const FieldPlace& place : m_fields) {
            const std::string_view word = FieldWord(place.field);
            const std::size_t size = std::min(word.size(), Width(place));
            out.append(static_cast<std::size_t>(place.first) - column, ' ');
            out += word.substr(0, size);
            column = static_cast<std::size_t>(place.first) + size;
        }
        out += '\n';
    }

    std::size_t LineEstimate() const {
        std::size_t end = 0;
        for (const FieldPlace& place : m_fields)
            end = std::max(end, static_cast<std::size_t>(place.last > 0 ? place.last : place.first));
        return end + kBytesPerField;
    }

    bool AppendPoint(std::string& out, const CPointGen& point, std::string& why) {
        const std::size_t start = out.size();
        std::size_t column = 1; // the column of the next character of the line
        for (const FieldPlace& place : m_fields) {
            const std::size_t width = Width(place);
            const auto first = static_cast<std::size_t>(place.first);
            std::string_view text;
            if (place.field == RecordField::Type)
                text = m_type; // fits: checked with the layout
            else if (place.field == RecordField::Matricule || place.field == RecordField::Code)
                text = place.field == RecordField::Matricule ? std::string_view(point.mat()) : point.sym();
            if (!text.empty()) {
                const std::size_t length = Utf8Length(text);
                if (length > width) {
                    why = Sprintf(place.field == RecordField::Code ? fb::kWhyCodeTooLong
                                                                   : fb::kWhyIdentifierTooLong,
                                  static_cast<int>(width));
                    out.resize(start);
                    return false;
                }
                out.append(first - column, ' ');
                out += text;
                column = first + length;
                continue;
            }
            if (!IsCoordinate(place.field)) continue;
            const double value = Coordinate(point, place.field);
            if (!IsKnown(value)) continue;
            if (!Fit(value / m_metresPerUnit, width)) {
                why = Sprintf(fb::kWhyCoordinateTooLarge, FieldWord(place.field),
                              Sprintf("colonnes %d à %d", place.first, place.last).c_str());
                out.resize(start);
                return false;
            }
            // Right-aligned in its columns; a field to the end of the line starts at its first column.
            const std::size_t end = place.last > 0 ? first + width : first + m_number.size();
            out.append(end - m_number.size() - column, ' ');
            out += m_number;
            column = end;
        }
        out += '\n';
        return true;
    }

private:
    static std::size_t Width(const FieldPlace& place) {
        return place.last > 0 ? static_cast<std::size_t>(place.last - place.first + 1) : std::string::npos;
    }

    // Puts into m_number the value in at most `width` characters: its shortest exact text, else rounded to
    // as many decimals as the columns leave after its whole part. False when even the whole part is too
    // long.
    bool Fit(double value, std::size_t width) {
        m_number.clear();
        AppendShortest(m_number, value);
        if (m_number.size() > width) {
            const std::size_t whole = std::min(m_number.find('.'), m_number.size());
            if (whole > width) return false;
            int decimals = whole + 1 < width ? static_cast<int>(width - whole - 1) : 0;
            for (;; --decimals) {
                m_number.clear();
                AppendFixedShown(m_number, value, decimals);
                if (m_number.size() <= width) break;
                if (decimals == 0) return false; // rounded up to one more digit: 9999.7 in four columns
            }
        }
        if (m_layout.decimal == ',') UseDecimalComma(m_number, 0);
        return true;
    }

    const RecordLayout& m_layout;
    std::vector<FieldPlace> m_fields; // by column
    std::string_view m_type;
    double m_metresPerUnit;
    std::string m_number; // the text of the number being fitted, kept from point to point
};

// Whether the file holds nothing yet, and whether its last line ends.
struct FileEnd {
    bool empty = true;
    bool lineEnded = true;
};

FileEnd LookAtEnd(const std::string& path) {
    FileEnd end;
    std::FILE* file = std::fopen(path.c_str(), "rb");
    if (!file) return end;
    if (std::fseek(file, -1, SEEK_END) == 0) {
        const int last = std::fgetc(file);
        if (last != EOF) {
            end.empty = false;
            end.lineEnded = last == '\n' || last == '\r';
        }
    }
    std::fclose(file);
    return end;
}

template <class Writer>
bool WritePoints(const PointExportJob& job, const RecordLayout& layout, DistanceUnit unit) {
    Writer writer(layout, unit);
    const std::vector<int> points = ExportedPoints(job);
    const FileEnd end = job.append ? LookAtEnd(job.path) : FileEnd{};
    ExportFile file(job);
    std::string& text = file.Text();
    if (!end.lineEnded) text += '\n'; // the file's last line is not ours to lengthen
    // The header lines head the file only; a completed file has them already.
    if (end.empty) writer.AppendHeader(text, layout.headerLines);
    ExportRefusals refusals(job);
    std::string why;
    for (int index : points) {
        const auto& point = static_cast<const CPointGen&>(*job.carnet->GetAt(index));
        if (!Writable(point, why) || !writer.AppendPoint(text, point, why)) refusals.Refuse(point.mat(), why);
        file.Flush();
    }
    if (!file.Commit()) return false;
    refusals.Summarise();
    return true;
}

} // namespace

bool ExportLayoutPoints(const PointExportJob& job, FieldBookFormat format) {
    if (!CheckExportSettingsFile(job)) return false;
    CParamDriver settings("", job.paramFile, format);
    FailureFrontEnd failures(ExportFrontEnd(job));
    if (!settings.Load(&failures)) return false;
    const RecordLayout layout = settings.Layout();
    const char* key = nullptr;
    if (const std::string why = UnfitForPoints(layout, key); !why.empty()) {
        ExportFrontEnd(job).ReportFailure(
            Sprintf(fb::kMsgParamBadText, job.paramFile.c_str(), key, why.c_str()));
        return false;
    }
    return layout.columnar ? WritePoints<ColumnarWriter>(job, layout, settings.Distances())
                           : WritePoints<DelimitedWriter>(job, layout, settings.Distances());
}

bool CDlgConfigSep::Export(const PointExportJob& job) {
    return ExportLayoutPoints(job, FieldBookFormat::Separateur);
}

bool CDlgConfigCol::Export(const PointExportJob& job) {
    return ExportLayoutPoints(job, FieldBookFormat::Colonne);
}

} // namespace pyr
