#include "fieldbook/ParamDriver.h"

#include "core/Files.h"
#include "core/Numbers.h"
#include "core/SafeFile.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookTexts.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <cerrno>

namespace pyr {

namespace {

using Key = CParamDriver::Key;

// Words of the keys, as a surveyor types them in the file.
constexpr const char* kGrades = "grades";
constexpr const char* kDegres = "degres";
constexpr const char* kDms = "dms";
constexpr const char* kMils = "mils";
constexpr const char* kMetres = "metres";
constexpr const char* kPieds = "pieds";
constexpr const char* kOrderXY = "XY";
constexpr const char* kOrderYX = "YX";
constexpr const char* kAucune = "aucune";
constexpr const char* kPremiere = "premiere";
constexpr const char* kCodes = "codes";
constexpr const char* kAuto = "auto";
constexpr const char* kWords84 = "84";
constexpr const char* kBlock41 = "41";
constexpr const char* kTab = "TAB";
constexpr const char* kEspace = "ESPACE";
constexpr int kMaxHeaderLines = 1000;

const std::vector<Key>& InstrumentKeys() {
    static const std::vector<Key> keys{
        {kKeyUniteAngles, kGrades, {kGrades, kDegres, kDms, kMils}},
        {kKeyUniteDistances, kMetres, {kMetres, kPieds}},
        {kKeyOrdreCoordonnees, kOrderXY, {kOrderXY, kOrderYX}},
        {kKeyReferences, kAucune, {kAucune, kPremiere, kCodes}},
        {kKeyCodesReference, "", {}},
    };
    return keys;
}

const std::vector<Key>& WildKeys() {
    static const std::vector<Key> keys = [] {
        std::vector<Key> all = InstrumentKeys();
        all.push_back({kKeyConventionStation, kAuto, {kAuto, kWords84, kBlock41}});
        all.push_back({kKeyCodesStation, "2,21", {}});
        all.push_back({kKeyPointsCalcules, "0", {"0", "1"}});
        return all;
    }();
    return keys;
}

// The keys of each instrument format: the common ones, then what that format's reader also needs.
const std::vector<Key>& WithComputedPoints() {
    static const std::vector<Key> keys = [] {
        std::vector<Key> all = InstrumentKeys();
        all.push_back({kKeyPointsCalcules, "0", {"0", "1"}});
        return all;
    }();
    return keys;
}
const std::vector<Key>& GeotronicsKeys() {
    return WithComputedPoints();
}
const std::vector<Key>& NikonKeys() {
    return WithComputedPoints();
}
// SDR collectors write the northing first unless their header says otherwise.
const std::vector<Key>& SokkiaKeys() {
    static const std::vector<Key> keys = [] {
        std::vector<Key> all = WithComputedPoints();
        for (Key& key : all)
            if (std::string_view(key.name) == kKeyOrdreCoordonnees) key.defaultValue = kOrderYX;
        return all;
    }();
    return keys;
}
const std::vector<Key>& TopconKeys() {
    return WithComputedPoints();
}
// Zeiss instruments name their northing X: it comes first unless the field book's header says otherwise.
const std::vector<Key>& ZeissKeys() {
    static const std::vector<Key> keys = [] {
        std::vector<Key> zeiss = WithComputedPoints();
        auto order = std::find_if(zeiss.begin(), zeiss.end(), [](const Key& key) {
            return std::string_view(key.name) == kKeyOrdreCoordonnees;
        });
        order->defaultValue = kOrderYX;
        return zeiss;
    }();
    return keys;
}

std::vector<Key> LayoutKeys(bool columnar) {
    std::vector<Key> keys;
    if (!columnar) keys.push_back({kKeySeparateur, ";", {}});
    keys.push_back({kKeySeparateurDecimal, ".", {".", ","}});
    keys.push_back({kKeyLignesEntete, "0", {}, kMaxHeaderLines});
    keys.push_back({kKeyUniteAngles, kGrades, {kGrades, kDegres, kDms, kMils}});
    keys.push_back({kKeyUniteDistances, kMetres, {kMetres, kPieds}});
    keys.push_back({kKeyTypeStation, "ST", {}});
    keys.push_back({kKeyTypeReference, "RF", {}});
    keys.push_back({kKeyTypeMesure, "MS", {}});
    keys.push_back({kKeyTypePoint, "PT", {}});
    keys.push_back({kKeyTypeCode, "CD", {}});
    keys.push_back({kKeyTypeCommentaire, "CO", {}});
    if (columnar) {
        keys.push_back({kKeyChampsStation, "TYPE:1-2,MATRICULE:4-19,HI:21-30,CODE:32-", {}});
        keys.push_back(
            {kKeyChampsVisee, "TYPE:1-2,MATRICULE:4-19,HP:21-30,AH:32-43,AV:45-56,DI:58-69,CODE:71-", {}});
        keys.push_back({kKeyChampsPoint, "TYPE:1-2,MATRICULE:4-19,X:21-34,Y:36-49,Z:51-60,CODE:62-", {}});
    } else {
        keys.push_back({kKeyChampsStation, "TYPE,MATRICULE,HI,CODE", {}});
        keys.push_back({kKeyChampsVisee, "TYPE,MATRICULE,HP,AH,AV,DI,CODE", {}});
        keys.push_back({kKeyChampsPoint, "TYPE,MATRICULE,X,Y,Z,CODE", {}});
    }
    return keys;
}

std::span<const Key> KeysOf(FieldBookFormat format) {
    static const std::vector<Key> delimited = LayoutKeys(false);
    static const std::vector<Key> columnar = LayoutKeys(true);
    switch (format) {
    case FieldBookFormat::Geotronics:
        return GeotronicsKeys();
    case FieldBookFormat::NikonAtlas:
    case FieldBookFormat::NikonKheops:
    case FieldBookFormat::NikonPsion:
        return NikonKeys();
    case FieldBookFormat::Sokkia:
        return SokkiaKeys();
    case FieldBookFormat::TopconGT7:
        return TopconKeys();
    case FieldBookFormat::Zeiss:
        return ZeissKeys();
    case FieldBookFormat::Wild:
        return WildKeys();
    case FieldBookFormat::Separateur:
        return delimited;
    case FieldBookFormat::Colonne:
        return columnar;
    case FieldBookFormat::Quendal:
        return {};
    }
    return InstrumentKeys();
}

struct FieldName {
    const char* word;
    RecordField field;
};
constexpr FieldName kFieldNames[] = {
    {"TYPE", RecordField::Type},     {"MATRICULE", RecordField::Matricule},
    {"HI", RecordField::HI},         {"V0", RecordField::V0},
    {"HP", RecordField::HP},         {"AH", RecordField::AH},
    {"AV", RecordField::AV},         {"DI", RecordField::DI},
    {"X", RecordField::X},           {"Y", RecordField::Y},
    {"Z", RecordField::Z},           {"CODE", RecordField::Code},
    {"IGNORE", RecordField::Ignore},
};

const char* FieldWord(RecordField field) {
    for (const auto& name : kFieldNames)
        if (name.field == field) return name.word;
    return "";
}

// Reads "first-last" or "first-" (to the end of the line): columns counted from 1.
bool ParseColumns(std::string_view text, FieldPlace& place) {
    const std::size_t dash = text.find('-');
    if (dash == std::string_view::npos) return false;
    long long first = 0, last = 0;
    if (!ParseInt(text.substr(0, dash), first) || first < 1 || first > 100000) return false;
    const std::string_view end = Trimmed(text.substr(dash + 1));
    if (!end.empty() && (!ParseInt(end, last) || last < first || last > 100000)) return false;
    place.first = static_cast<int>(first);
    place.last = static_cast<int>(last);
    return true;
}

bool Contains(const std::vector<FieldPlace>& fields, RecordField field) {
    return std::any_of(fields.begin(), fields.end(),
                       [field](const FieldPlace& f) { return f.field == field; });
}

// The fields a kind of record may hold, besides TYPE, CODE and IGNORE.
bool FieldFits(RecordField field, std::string_view key) {
    using enum RecordField;
    if (field == Type || field == Matricule || field == Code || field == Ignore) return true;
    if (key == kKeyChampsStation) return field == HI || field == V0;
    if (key == kKeyChampsVisee) return field == HP || field == AH || field == AV || field == DI;
    return field == X || field == Y || field == Z;
}

std::string CheckFieldList(std::string_view key, const std::vector<FieldPlace>& fields) {
    for (const auto& place : fields)
        if (!FieldFits(place.field, key)) return Sprintf(fb::kWhyFieldNotHere, FieldWord(place.field));
    if (!fields.empty() && !Contains(fields, RecordField::Matricule)) return fb::kWhyNoMatricule;
    return {};
}

bool IsWord(const std::string& value, const Key& key) {
    return std::any_of(key.words.begin(), key.words.end(),
                       [&value](const char* word) { return EqualIgnoringCase(value, word); });
}

std::string Words(const Key& key) {
    std::string words;
    for (const char* word : key.words)
        words += (words.empty() ? "" : ", ") + std::string(word);
    return words;
}

} // namespace

std::vector<std::string> SplitList(std::string_view text) {
    std::vector<std::string> items;
    std::size_t start = 0;
    while (start <= text.size()) {
        std::size_t comma = text.find(',', start);
        if (comma == std::string_view::npos) comma = text.size();
        const std::string_view item = Trimmed(text.substr(start, comma - start));
        if (!item.empty()) items.emplace_back(item);
        start = comma + 1;
    }
    return items;
}

bool ParseFieldList(std::string_view text, bool columnar, std::vector<FieldPlace>& fields,
                    std::string& error) {
    fields.clear();
    for (const std::string& item : SplitList(text)) {
        const std::size_t colon = item.find(':');
        const std::string word(Trimmed(std::string_view(item).substr(0, colon)));
        const auto* name =
            std::find_if(std::begin(kFieldNames), std::end(kFieldNames),
                         [&word](const FieldName& n) { return EqualIgnoringCase(word, n.word); });
        if (name == std::end(kFieldNames)) {
            error = Sprintf(fb::kWhyUnknownField, word.c_str());
            return false;
        }
        FieldPlace place{name->field};
        if (place.field != RecordField::Ignore && Contains(fields, place.field)) {
            error = Sprintf(fb::kWhyFieldTwice, name->word);
            return false;
        }
        if (columnar && colon == std::string::npos) {
            error = Sprintf(fb::kWhyNoColumns, name->word, name->word);
            return false;
        }
        if (!columnar && colon != std::string::npos) {
            error = Sprintf(fb::kWhyColumnsInDelimited, name->word);
            return false;
        }
        if (columnar && !ParseColumns(std::string_view(item).substr(colon + 1), place)) {
            error = Sprintf(fb::kWhyBadColumns, name->word);
            return false;
        }
        fields.push_back(place);
    }
    return true;
}

CParamDriver::CParamDriver(std::string installDir, std::string paramFile, FieldBookFormat format)
    : m_installDir(std::move(installDir)), m_file(std::move(paramFile)), m_format(format) {
    for (const Key& key : Keys())
        m_values[key.name] = key.defaultValue;
}

std::span<const CParamDriver::Key> CParamDriver::Keys() const {
    return KeysOf(m_format);
}

bool CParamDriver::Load(const std::string& path, ui::FrontEnd* parent) {
    m_file = path;
    return Load(parent);
}

bool CParamDriver::Load(ui::FrontEnd* parent) {
    std::string bytes;
    if (!ReadWholeFile(m_file, bytes)) {
        const std::string why = SystemErrorText(errno);
        ShowParamMessage(parent, Sprintf(fb::kMsgParamUnreadable, m_file.c_str(), why.c_str()));
        return false;
    }
    for (const Key& key : Keys())
        ReadParamString(m_file, kSectionParametrage, key.name, key.defaultValue, m_values[key.name]);
    const std::string why = Validate();
    if (!why.empty()) {
        ShowParamMessage(parent, why);
        return false;
    }
    return true;
}

std::string CParamDriver::Validate() const {
    const char* file = m_file.c_str();
    bool anyType = false, allType = true;
    for (const Key& key : Keys()) {
        const std::string& value = Text(key.name);
        if (!key.words.empty() && !IsWord(value, key))
            return Sprintf(fb::kMsgParamBadWord, file, value.c_str(), key.name, Words(key).c_str());
        long long count = 0;
        if (key.maximum >= 0 && (!ParseInt(value, count) || count < 0 || count > key.maximum))
            return Sprintf(fb::kMsgParamBadCount, file, value.c_str(), key.name, key.maximum);
        if (std::string_view(key.name) == kKeySeparateur && value.empty())
            return Sprintf(fb::kMsgParamBadText, file, key.name, fb::kWhyEmptySeparator);
        const std::string_view name(key.name);
        if (name == kKeyChampsStation || name == kKeyChampsVisee || name == kKeyChampsPoint) {
            std::vector<FieldPlace> fields;
            std::string why;
            if (ParseFieldList(value, m_format == FieldBookFormat::Colonne, fields, why))
                why = CheckFieldList(name, fields);
            if (!why.empty()) return Sprintf(fb::kMsgParamBadText, file, key.name, why.c_str());
            if (!fields.empty()) {
                const bool typed = Contains(fields, RecordField::Type);
                anyType = anyType || typed;
                allType = allType && typed;
            }
        }
    }
    if (anyType && !allType)
        return Sprintf(fb::kMsgParamBadText, file, kKeyChampsPoint, fb::kWhyTypeEverywhere);
    return {};
}

bool CParamDriver::Save() const {
    bool saved = true;
    for (const Key& key : Keys())
        saved = WriteParamString(m_file, kSectionParametrage, key.name, Text(key.name)) && saved;
    return saved;
}

void CParamDriver::Edit(ui::FrontEnd& frontEnd) {
    if (!FileExists(m_file)) {
        // A new file starts as a copy of the installation's, with its explanations; else with the defaults.
        const char* shipped = FormatInfo(m_format).parameterFile;
        const std::string installed = shipped ? InstallationConfigFile(m_installDir, shipped) : std::string();
        const bool copied =
            !installed.empty() && FileExists(installed) && CopyFileContents(installed, m_file) == 0;
        if (!copied && !Save()) return;
    }
    frontEnd.ShowFile(m_file);
}

const std::string& CParamDriver::Text(std::string_view key) const {
    static const std::string none;
    auto found = m_values.find(key);
    return found == m_values.end() ? none : found->second;
}

void CParamDriver::SetText(std::string_view key, std::string value) {
    m_values[std::string(key)] = std::move(value);
}

AngleUnit CParamDriver::Angles() const {
    const std::string& unit = Text(kKeyUniteAngles);
    if (EqualIgnoringCase(unit, kDegres)) return AngleUnit::Degrees;
    if (EqualIgnoringCase(unit, kDms)) return AngleUnit::Dms;
    if (EqualIgnoringCase(unit, kMils)) return AngleUnit::Mils;
    return AngleUnit::Grads;
}

DistanceUnit CParamDriver::Distances() const {
    return EqualIgnoringCase(Text(kKeyUniteDistances), kPieds) ? DistanceUnit::Feet : DistanceUnit::Metres;
}

CoordinateOrder CParamDriver::Order() const {
    return EqualIgnoringCase(Text(kKeyOrdreCoordonnees), kOrderYX) ? CoordinateOrder::NorthEast
                                                                   : CoordinateOrder::EastNorth;
}

ReferenceMarking CParamDriver::References() const {
    const std::string& marking = Text(kKeyReferences);
    if (EqualIgnoringCase(marking, kPremiere)) return ReferenceMarking::First;
    if (EqualIgnoringCase(marking, kCodes)) return ReferenceMarking::Codes;
    return ReferenceMarking::None;
}

std::vector<std::string> CParamDriver::ReferenceCodes() const {
    return SplitList(Text(kKeyCodesReference));
}

StationConvention CParamDriver::Stations() const {
    const std::string& convention = Text(kKeyConventionStation);
    if (convention == kWords84) return StationConvention::Words84;
    if (convention == kBlock41) return StationConvention::CodeBlock41;
    return StationConvention::Auto;
}

std::vector<std::string> CParamDriver::StationCodes() const {
    return SplitList(Text(kKeyCodesStation));
}

bool InstrumentSettings::MarksReference(bool firstSighting, std::string_view code) const {
    switch (marking) {
    case ReferenceMarking::First:
        return firstSighting;
    case ReferenceMarking::Codes:
        return !code.empty() && IsAnyOf(code, referenceCodes);
    case ReferenceMarking::None:
        break;
    }
    return false;
}

InstrumentSettings ReadInstrumentSettings(const CParamDriver* driver, CoordinateOrder order) {
    if (!driver) {
        InstrumentSettings defaults;
        defaults.order = order;
        return defaults;
    }
    return {driver->Angles(),     driver->Distances(),      driver->Order(),
            driver->References(), driver->ReferenceCodes(), driver->Text(kKeyPointsCalcules) == "1"};
}

RecordLayout CParamDriver::Layout() const {
    RecordLayout layout;
    layout.columnar = m_format == FieldBookFormat::Colonne;
    const std::string& separator = Text(kKeySeparateur);
    if (EqualIgnoringCase(separator, kTab))
        layout.separator = "\t";
    else if (EqualIgnoringCase(separator, kEspace))
        layout.separator = " ";
    else if (!separator.empty())
        layout.separator = separator;
    layout.decimal = Text(kKeySeparateurDecimal) == "," ? ',' : '.';
    layout.headerLines = LenientAtoi(Text(kKeyLignesEntete));
    layout.typeStation = Text(kKeyTypeStation);
    layout.typeReference = Text(kKeyTypeReference);
    layout.typeMesure = Text(kKeyTypeMesure);
    layout.typePoint = Text(kKeyTypePoint);
    layout.typeCode = Text(kKeyTypeCode);
    layout.typeComment = Text(kKeyTypeCommentaire);
    std::string ignored;
    ParseFieldList(Text(kKeyChampsStation), layout.columnar, layout.station, ignored);
    ParseFieldList(Text(kKeyChampsVisee), layout.columnar, layout.sighting, ignored);
    ParseFieldList(Text(kKeyChampsPoint), layout.columnar, layout.point, ignored);
    return layout;
}

} // namespace pyr
