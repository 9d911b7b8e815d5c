#include "fieldbook/QuendalReader.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookTexts.h"
#include "geobase/Carnet.h"
#include "geobase/Matricule.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>

namespace pyr {

namespace {

// The names of the data, for "donnée manquante pour %s".
constexpr const char* kDatumStation = "le nom de la station";
constexpr const char* kDatumPoint = "le matricule du point";
constexpr const char* kDatumInstrument = "le nom de l'appareil";
constexpr const char* kDatumTraverse = "le nom du cheminement";
constexpr const char* kDatumCode = "le code";
constexpr const char* kDatumCommand = "le mot de commande";

// A number written with a decimal comma, as a spreadsheet set to French writes it, is read too: the
// fields are separated by ';', so the comma can mean nothing else.
bool ParseNumber(std::string_view text, double& value) {
    if (ParseDouble(text, value)) return true;
    if (std::count(text.begin(), text.end(), ',') != 1 || text.find('.') != std::string_view::npos)
        return false;
    std::string point(text);
    std::replace(point.begin(), point.end(), ',', '.');
    return ParseDouble(point, value);
}

} // namespace

void CQuendalReader::ReadLine(std::string_view line, int number) {
    if (Trimmed(line).empty()) return;
    qdl::SplitFields(line, m_fields, m_scratch);
    const std::string_view word = m_fields[0];
    if (EqualIgnoringCase(word, qdl::kHeader)) {
        const int version = LenientAtoi(m_fields[1]);
        if (version > qdl::kVersion && TextWindow())
            TextWindow()->Print(fb::kNewerQuendal, number, version, qdl::kVersion);
    } else if (EqualIgnoringCase(word, qdl::kStation)) {
        ReadStation(number);
    } else if (EqualIgnoringCase(word, qdl::kReference)) {
        ReadSighting(number, true);
    } else if (EqualIgnoringCase(word, qdl::kMesure)) {
        ReadSighting(number, false);
    } else if (EqualIgnoringCase(word, qdl::kPoint)) {
        ReadPoint(number);
    } else if (EqualIgnoringCase(word, qdl::kCode)) {
        ReadCode(number, false);
    } else if (EqualIgnoringCase(word, qdl::kCommand)) {
        ReadCode(number, true);
    } else if (EqualIgnoringCase(word, qdl::kComment)) {
        ReadComment(line, number);
    } else if (EqualIgnoringCase(word, qdl::kInstrument)) {
        ReadInstrument(number);
    } else if (EqualIgnoringCase(word, qdl::kBackReading)) {
        ReadLevelling(number, true);
    } else if (EqualIgnoringCase(word, qdl::kForeReading)) {
        ReadLevelling(number, false);
    } else if (EqualIgnoringCase(word, qdl::kTraverse)) {
        ReadTraverse(line, number);
    } else {
        LineUnrecognised(number);
    }
}

bool CQuendalReader::Number(std::size_t field, int line, double& value) {
    const std::string_view text = m_fields[field];
    value = kUndefined;
    if (text.empty() || ParseNumber(text, value)) return true;
    if (TextWindow()) TextWindow()->Print(fb::kBadNumber, line, std::string(text).c_str());
    return false;
}

bool CQuendalReader::Name(std::size_t field, int line, const char* datum, std::string& name) {
    name.assign(m_fields[field]);
    if (!name.empty()) return true;
    LineMissing(line, datum);
    return false;
}

void CQuendalReader::ExtraFields(int line, std::size_t expected) {
    if (m_fields.count > expected && TextWindow())
        TextWindow()->Print(fb::kExtraFields, line, static_cast<int>(m_fields.count - expected));
}

void CQuendalReader::ReadInstrument(int line) {
    std::string name;
    double values[6];
    if (!Name(1, line, kDatumInstrument, name)) return;
    for (std::size_t i = 0; i < 6; ++i) {
        if (!Number(2 + i, line, values[i])) return;
        if (IsUndefined(values[i])) values[i] = 0.0; // a constant not given is none
    }
    ExtraFields(line, 8);
    InstrumentOptions instrument{name, values[1], values[0], values[2], values[3], values[4], values[5]};
    Result().Add(MakeInstrument(instrument), kKindAppareil);
}

void CQuendalReader::ReadStation(int line) {
    std::string name;
    double hi, v0;
    if (!Name(1, line, kDatumStation, name) || !Number(2, line, hi) || !Number(3, line, v0)) return;
    ExtraFields(line, 5);
    AddStation(std::move(name), hi, v0, std::string(m_fields[4]));
}

void CQuendalReader::ReadSighting(int line, bool reference) {
    std::string point;
    double hp, ah, av, di;
    if (!Name(1, line, kDatumPoint, point) || !Number(2, line, hp) || !Number(3, line, ah) ||
        !Number(4, line, av) || !Number(5, line, di))
        return;
    ExtraFields(line, 7);
    if (reference)
        AddReference(std::move(point), hp, ah, av, di, std::string(m_fields[6]));
    else
        AddMesure(std::move(point), hp, ah, av, di, std::string(m_fields[6]));
}

void CQuendalReader::ReadPoint(int line) {
    std::string name;
    double x, y, z;
    if (!Name(1, line, kDatumPoint, name) || !Number(2, line, x) || !Number(3, line, y) ||
        !Number(4, line, z))
        return;
    ExtraFields(line, 7);
    const std::string_view invariance = m_fields[6];
    CPointGen* point = AddPoint(std::move(name), x, y, z, std::string(m_fields[5]));
    if (!point) return;
    point->setInvariantXY(EqualIgnoringCase(invariance, qdl::kInvariantXY) ||
                          EqualIgnoringCase(invariance, qdl::kInvariantXYZ));
    point->setInvariantZ(EqualIgnoringCase(invariance, qdl::kInvariantZ) ||
                         EqualIgnoringCase(invariance, qdl::kInvariantXYZ));
}

void CQuendalReader::ReadLevelling(int line, bool back) {
    std::string point;
    double reading, distance;
    if (!Name(1, line, kDatumPoint, point) || !Number(2, line, reading) || !Number(3, line, distance)) return;
    ExtraFields(line, 5);
    FormMat(point);
    std::string code(m_fields[4]);
    if (back)
        Result().Add(std::make_unique<CLectAR>(std::move(point), reading, distance, std::move(code)),
                     kKindLectAR);
    else
        Result().Add(std::make_unique<CLectAV>(std::move(point), reading, distance, std::move(code)),
                     kKindLectAV);
}

void CQuendalReader::ReadTraverse(std::string_view text, int line) {
    const std::vector<std::string> fields = qdl::SplitAllFields(text);
    if (fields.size() < 2 || fields[1].empty()) {
        LineMissing(line, kDatumTraverse);
        return;
    }
    auto traverse = std::make_unique<CChemin>(fields[1]);
    traverse->setClosed(fields.size() > 2 && fields[2] == "1");
    for (std::size_t i = 3; i < fields.size(); ++i)
        if (!fields[i].empty()) traverse->add(fields[i]);
    Result().Add(std::move(traverse), kKindChemin);
}

// CODE: a field code as the surveyor typed it. COMMANDE: a command already interpreted, kept with its
// kind whatever the table (an unknown word makes an uninterpreted command).
void CQuendalReader::ReadCode(int line, bool interpreted) {
    std::string word;
    if (!Name(1, line, interpreted ? kDatumCommand : kDatumCode, word)) return;
    ExtraFields(line, 5);
    std::string parameters(m_fields[2]);
    if (!interpreted && Choices().interpret && CodeTable()) {
        // The command keeps the point the code was written for.
        AddCode(parameters.empty() ? word : word + ' ' + parameters, m_fields[3]);
        return;
    }
    const int kind = interpreted ? CommandKind(word) : kKindCommand;
    auto command =
        std::make_unique<CCommande>(std::move(word), std::move(parameters), std::string(m_fields[3]));
    command->setSym(std::string(m_fields[4]));
    Result().Add(std::move(command), kind);
}

// The text of a comment runs to the end of the line unless it is written in quotes.
void CQuendalReader::ReadComment(std::string_view text, int line) {
    if (m_fields.count > 1 && m_fields.quoted[1]) {
        ExtraFields(line, 2);
        AddComment(std::string(m_fields[1]));
        return;
    }
    const std::size_t separator = text.find(qdl::kSeparator);
    AddComment(separator == std::string_view::npos ? std::string()
                                                   : std::string(Trimmed(text.substr(separator + 1))));
}

} // namespace pyr
