#include "editor/ElementFields.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Kinds.h"
#include "geobase/Matricule.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace pyr {

namespace {

constexpr const char* kNoElement = "L'élément # %d n'existe pas dans la GéoBase !";
constexpr const char* kNoSuchField = "Un élément de type %s n'a pas de champ « %s » !";
constexpr const char* kNotANumber = "%s : « %s » n'est pas un nombre !";
constexpr const char* kRequired = "%s : une valeur doit être indiquée !";
constexpr const char* kReserved = "%s : la valeur %s est réservée aux valeurs absentes !";
constexpr const char* kAngleRange = "%s : %s gr n'est pas un angle entre 0 et 400 gr !";
constexpr const char* kNegative = "%s : %s %s ne peut pas être négatif !";
constexpr const char* kControl = "%s : le texte contient une tabulation ou un caractère de contrôle !";
constexpr const char* kLineEnd = "%s : le texte contient un retour à la ligne !";
constexpr const char* kNotAFlag = "%s : « %s » n'est ni « Oui » ni « Non » !";
constexpr const char* kBadStation = "Stations : « %s » ne désigne pas une station (« S1 » ou « S1(2) ») !";
constexpr const char* kUnknownStation = "Stations : la station « %s » n'existe pas dans la GéoBase !";
constexpr const char* kNoWord = "Commande : le mot de la commande doit être indiqué !";
constexpr const char* kOtherCommand = "Commande : « %s » n'est pas une commande du type %s !";

constexpr int kStaffReadingDecimals = 4;

constexpr std::string_view kYes = "Oui";
constexpr std::string_view kNo = "Non";

// What the validation of the store says after the reason of a refusal: the element is not added.
// An edit refuses a change, not an addition: the reason alone is kept.
constexpr std::array<std::string_view, 2> kNotAddedEndings{" : elle n'est pas ajoutée à la GéoBase !",
                                                           " : il n'est pas ajouté à la GéoBase !"};

// ---------------------------------------------------------------- the fields of each kind

constexpr FieldInfo F(FieldKey key, std::string_view label, FieldType type, std::string_view unit = {}) {
    return {key, label, type, unit};
}

const FieldInfo kCode = F(FieldKey::Code, "Code", FieldType::Text);
const FieldInfo kPar = F(FieldKey::Parametres, "Paramètres", FieldType::Text);
const FieldInfo kMat = F(FieldKey::Matricule, "Matricule", FieldType::Identifier);
const FieldInfo kName = F(FieldKey::Matricule, "Nom", FieldType::Identifier);

const std::vector<FieldInfo> kCommentFields{F(FieldKey::Texte, "Texte", FieldType::Text)};
const std::vector<FieldInfo> kStationFields{kMat, F(FieldKey::HI, "HI", FieldType::Number, "m"),
                                            F(FieldKey::V0, "V0", FieldType::Number, "gr"), kCode, kPar};
const std::vector<FieldInfo> kSightingFields{kMat,
                                             F(FieldKey::HP, "HP", FieldType::Number, "m"),
                                             F(FieldKey::AH, "AH", FieldType::Number, "gr"),
                                             F(FieldKey::AV, "AV", FieldType::Number, "gr"),
                                             F(FieldKey::DI, "DI", FieldType::Number, "m"),
                                             kCode,
                                             kPar};
const std::vector<FieldInfo> kReadingFields{kMat, F(FieldKey::Lecture, "Lecture", FieldType::Number, "m"),
                                            F(FieldKey::Distance, "Distance", FieldType::Number, "m"), kCode,
                                            kPar};
const std::vector<FieldInfo> kPointFields{kMat,
                                          F(FieldKey::X, "X", FieldType::Number, "m"),
                                          F(FieldKey::Y, "Y", FieldType::Number, "m"),
                                          F(FieldKey::Z, "Z", FieldType::Number, "m"),
                                          F(FieldKey::InvariantXY, "XY invariants", FieldType::Flag),
                                          F(FieldKey::InvariantZ, "Z invariant", FieldType::Flag),
                                          kCode,
                                          kPar};
const std::vector<FieldInfo> kTraverseFields{kName, F(FieldKey::Stations, "Stations", FieldType::StationList),
                                             F(FieldKey::Ferme, "Fermé", FieldType::Flag), kCode, kPar};
const std::vector<FieldInfo> kInstrumentFields{
    kName,
    F(FieldKey::CollVerticale, "Collimation verticale", FieldType::Number, "gr"),
    F(FieldKey::ConstPrisme, "Constante de prisme", FieldType::Number, "m"),
    F(FieldKey::SigmaAh, "Écart type AH", FieldType::Number, "gr"),
    F(FieldKey::SigmaAv, "Écart type AV", FieldType::Number, "gr"),
    F(FieldKey::SigmaDi, "Écart type DI", FieldType::Number, "m"),
    F(FieldKey::SigmaPpm, "Écart type DI proportionnel", FieldType::Number, "mm/km"),
    kCode,
    kPar};
const std::vector<FieldInfo> kCommandFields{F(FieldKey::Commande, "Commande", FieldType::Text), kPar,
                                            F(FieldKey::Matricule, "Matricule", FieldType::Identifier),
                                            kCode};
const std::vector<FieldInfo> kNoFields;

struct KeyName {
    FieldKey key;
    std::string_view name;
};
constexpr std::array<KeyName, 26> kKeyNames{{
    {FieldKey::Matricule, "matricule"},
    {FieldKey::Texte, "texte"},
    {FieldKey::Commande, "commande"},
    {FieldKey::HI, "hi"},
    {FieldKey::V0, "v0"},
    {FieldKey::HP, "hp"},
    {FieldKey::AH, "ah"},
    {FieldKey::AV, "av"},
    {FieldKey::DI, "di"},
    {FieldKey::Lecture, "lecture"},
    {FieldKey::Distance, "distance"},
    {FieldKey::X, "x"},
    {FieldKey::Y, "y"},
    {FieldKey::Z, "z"},
    {FieldKey::InvariantXY, "invariant-xy"},
    {FieldKey::InvariantZ, "invariant-z"},
    {FieldKey::Stations, "stations"},
    {FieldKey::Ferme, "ferme"},
    {FieldKey::CollVerticale, "collimation"},
    {FieldKey::ConstPrisme, "prisme"},
    {FieldKey::SigmaAh, "sigma-ah"},
    {FieldKey::SigmaAv, "sigma-av"},
    {FieldKey::SigmaDi, "sigma-di"},
    {FieldKey::SigmaPpm, "sigma-ppm"},
    {FieldKey::Code, "code"},
    {FieldKey::Parametres, "parametres"},
}};

// ---------------------------------------------------------------- texts

std::string Joined(const std::vector<std::string>& stations) {
    std::string text;
    for (const std::string& station : stations) {
        if (!text.empty()) text += ", ";
        text += station;
    }
    return text;
}

bool IsDigit(char c) {
    return c >= '0' && c <= '9';
}

bool IsSeparator(char c) {
    return c == ',' || c == ';' || c == ' ' || c == '\t';
}

// A blank between digit groups: a space, a no-break space or a narrow no-break space.
std::size_t BlankAt(std::string_view text, std::size_t at) {
    if (text[at] == ' ') return 1;
    if (text.substr(at, 2) == "\xC2\xA0") return 2;
    if (text.substr(at, 3) == "\xE2\x80\xAF") return 3;
    return 0;
}

std::optional<bool> ParseFlag(std::string_view text) {
    text = Trimmed(text);
    for (std::string_view word : {"oui", "o", "1", "vrai"})
        if (EqualIgnoringCase(text, word)) return true;
    for (std::string_view word : {"non", "n", "0", "faux", ""})
        if (EqualIgnoringCase(text, word)) return false;
    return std::nullopt;
}

std::string WithoutNotAdded(std::string message) {
    while (!message.empty() && message.back() == '\n')
        message.pop_back();
    for (std::string_view ending : kNotAddedEndings)
        if (message.size() >= ending.size() &&
            std::string_view(message).substr(message.size() - ending.size()) == ending) {
            message.resize(message.size() - ending.size());
            message += " !";
            break;
        }
    return message;
}

// The text window of the store's validation, kept as text: the reason of a refusal.
class ReasonCatcher : public ui::FrontEnd {
public:
    std::string text;

    void MessageBox(std::string_view message, std::string_view, int) override { Line(message); }
    ui::Answer Ask(std::string_view, std::string_view, ui::Buttons, ui::Answer byDefault, int) override {
        return byDefault;
    }
    std::optional<std::string> ChooseFile(const ui::FileChoice&) override { return std::nullopt; }
    void TextLine(std::string_view line) override { Line(line); }
    ui::DialogResult DoModal(ui::Dialog&) override { return ui::DialogResult::Cancel; }
    void ShowFile(const std::string&) override {}

private:
    void Line(std::string_view line) {
        if (!text.empty()) text += '\n';
        text += line;
    }
};

// ---------------------------------------------------------------- setting one field

class FieldSetter {
public:
    FieldSetter(const CCarnet& carnet, int kind, CElement& element)
        : m_carnet(carnet), m_kind(kind), m_element(element) {}

    // An empty error when the field is set.
    std::string Set(FieldKey key, std::string_view text) {
        const FieldInfo* field = FindField(m_kind, key);
        if (!field)
            return Sprintf(kNoSuchField, std::string(KindLabel(m_kind)).c_str(),
                           std::string(FieldKeyName(key)).c_str());
        m_label = std::string(field->label);
        switch (field->type) {
        case FieldType::Text:
            return SetText(key, text);
        case FieldType::Identifier:
            return SetIdentifier(text);
        case FieldType::Flag:
            return SetFlag(key, text);
        case FieldType::StationList:
            return SetStations(text);
        case FieldType::Number:
            return SetNumber(key, *field, text);
        }
        return {};
    }

private:
    std::string SetText(FieldKey key, std::string_view text) {
        // Codes and command words are single words of a table: no control character at all. Parameters
        // and comments may hold a tabulation (the file escapes it) but stay on one line of the view.
        const bool word = key == FieldKey::Code || key == FieldKey::Commande;
        for (char c : text) {
            const auto byte = static_cast<unsigned char>(c);
            if (word && (byte < 0x20 || byte == 0x7F)) return Sprintf(kControl, m_label.c_str());
            if (c == '\n' || c == '\r') return Sprintf(kLineEnd, m_label.c_str());
        }
        switch (key) {
        case FieldKey::Code:
            m_element.setSym(std::string(text));
            break;
        case FieldKey::Parametres:
            m_element.setPar(std::string(text));
            break;
        case FieldKey::Texte:
            static_cast<CComment&>(m_element).setText(std::string(text));
            break;
        case FieldKey::Commande: {
            const std::string_view word = Trimmed(text);
            if (word.empty()) return kNoWord;
            // The kind of a command follows its word: an edit keeps the element's kind.
            if (CommandKind(word) != m_kind)
                return Sprintf(kOtherCommand, std::string(word).c_str(),
                               std::string(CommandWord(m_kind)).c_str());
            static_cast<CCommande&>(m_element).setWord(std::string(word));
            break;
        }
        default:
            break;
        }
        return {};
    }

    std::string SetIdentifier(std::string_view text) {
        std::string mat(Trimmed(text));
        // A command names a point only when it is about one.
        if (mat.empty() && IsCommandKind(m_kind)) {
            m_element.setMat({});
            return {};
        }
        if (mat.empty()) return msg::kMatMissing;
        std::string why;
        if (!IsValidMat(mat, &why)) return Sprintf(msg::kMatIncorrect, mat.c_str(), why.c_str());
        FormMat(mat);
        m_element.setMat(std::move(mat));
        return {};
    }

    std::string SetFlag(FieldKey key, std::string_view text) {
        const std::optional<bool> on = ParseFlag(text);
        if (!on) return Sprintf(kNotAFlag, m_label.c_str(), std::string(Trimmed(text)).c_str());
        if (key == FieldKey::Ferme)
            static_cast<CChemin&>(m_element).setClosed(*on);
        else if (key == FieldKey::InvariantXY)
            static_cast<CPointGen&>(m_element).setInvariantXY(*on);
        else
            static_cast<CPointGen&>(m_element).setInvariantZ(*on);
        return {};
    }

    // "S1, S2(2) S3": each station designated by its name and, past its first set-up, its reprise; each
    // one must stand in the GéoBase, so that the traverse can be computed.
    std::string SetStations(std::string_view text) {
        std::vector<std::string> stations;
        std::size_t at = 0;
        while (at < text.size()) {
            while (at < text.size() && IsSeparator(text[at]))
                ++at;
            std::size_t end = at;
            // A reprise may be written apart from its name: "S2 (2)".
            while (end < text.size() && !IsSeparator(text[end]))
                ++end;
            std::size_t next = end;
            while (next < text.size() && text[next] == ' ')
                ++next;
            if (next < text.size() && text[next] == '(') {
                end = text.find(')', next);
                end = end == std::string_view::npos ? text.size() : end + 1;
            }
            if (end == at) break;
            const std::string_view item = text.substr(at, end - at);
            at = end;
            std::string name;
            int reprise = 0;
            if (!CCarnet::extrStaRep(item, name, reprise) || !IsValidMat(name))
                return Sprintf(kBadStation, std::string(item).c_str());
            FormMat(name);
            if (m_carnet.findStaRep(name, reprise) < 0)
                return Sprintf(kUnknownStation, std::string(item).c_str());
            stations.push_back(reprise > 1 ? Sprintf("%s(%d)", name.c_str(), reprise) : name);
        }
        auto& traverse = static_cast<CChemin&>(m_element);
        CChemin rebuilt(traverse.mat(), traverse.sym());
        rebuilt.setPar(traverse.par());
        rebuilt.setClosed(traverse.isClosed());
        for (std::string& station : stations)
            rebuilt.add(std::move(station));
        traverse = rebuilt;
        return {};
    }

    std::string SetNumber(FieldKey key, const FieldInfo& field, std::string_view text) {
        double value = kUndefined;
        const std::string_view typed = Trimmed(text);
        if (typed.empty()) {
            if (!MayBeUndefined(key)) return Sprintf(kRequired, m_label.c_str());
        } else {
            if (!ParseTypedNumber(typed, value))
                return Sprintf(kNotANumber, m_label.c_str(), std::string(typed).c_str());
            const std::string shown = FormatShortest(value);
            if (IsUndefined(value)) return Sprintf(kReserved, m_label.c_str(), shown.c_str());
            if (IsAngle(key) && !(value >= 0.0 && value < 400.0))
                return Sprintf(kAngleRange, m_label.c_str(), shown.c_str());
            if (MustBePositive(key) && value < 0.0)
                return Sprintf(kNegative, m_label.c_str(), shown.c_str(), std::string(field.unit).c_str());
        }
        Write(key, value);
        return {};
    }

    // Which numbers an element may lack. A station without HI or V0, a sighting without target height,
    // zenith angle or distance, a reading without distance, a point without planimetry or altitude are
    // all found in field books; a sighting is a direction first, and every computation that uses one
    // reads its AH. The levelling reading and the instrument's constants are what those elements are.
    static bool MayBeUndefined(FieldKey key) {
        switch (key) {
        case FieldKey::HI:
        case FieldKey::V0:
        case FieldKey::HP:
        case FieldKey::AV:
        case FieldKey::DI:
        case FieldKey::Distance:
        case FieldKey::X:
        case FieldKey::Y:
        case FieldKey::Z:
            return true;
        default:
            return false;
        }
    }
    // Directions and zenith angles, read on a circle of 400 gr. The collimation is a correction, signed.
    static bool IsAngle(FieldKey key) {
        return key == FieldKey::V0 || key == FieldKey::AH || key == FieldKey::AV;
    }
    // Heights above the mark, lengths and precisions.
    static bool MustBePositive(FieldKey key) {
        switch (key) {
        case FieldKey::HI:
        case FieldKey::DI:
        case FieldKey::Distance:
        case FieldKey::SigmaAh:
        case FieldKey::SigmaAv:
        case FieldKey::SigmaDi:
        case FieldKey::SigmaPpm:
            return true;
        default:
            return false;
        }
    }

    void Write(FieldKey key, double value) {
        switch (key) {
        case FieldKey::HI:
            static_cast<CStation&>(m_element).setHI(value);
            break;
        case FieldKey::V0:
            static_cast<CStation&>(m_element).setV0(value);
            break;
        case FieldKey::HP:
            static_cast<CVisee&>(m_element).setHP(value);
            break;
        case FieldKey::AH:
            static_cast<CVisee&>(m_element).setAH(value);
            break;
        case FieldKey::AV:
            static_cast<CVisee&>(m_element).setAV(value);
            break;
        case FieldKey::DI:
            static_cast<CVisee&>(m_element).setDI(value);
            break;
        case FieldKey::Lecture:
            static_cast<CLecture&>(m_element).setLM(value);
            break;
        case FieldKey::Distance:
            static_cast<CLecture&>(m_element).setDist(value);
            break;
        case FieldKey::X:
            static_cast<CPointGen&>(m_element).setX(value);
            break;
        case FieldKey::Y:
            static_cast<CPointGen&>(m_element).setY(value);
            break;
        case FieldKey::Z:
            static_cast<CPointGen&>(m_element).setZ(value);
            break;
        case FieldKey::CollVerticale:
            static_cast<CAppareil&>(m_element).setCollVerticale(value);
            break;
        case FieldKey::ConstPrisme:
            static_cast<CAppareil&>(m_element).setConstPrisme(value);
            break;
        case FieldKey::SigmaAh:
            static_cast<CAppareil&>(m_element).setSigmaAh(value);
            break;
        case FieldKey::SigmaAv:
            static_cast<CAppareil&>(m_element).setSigmaAv(value);
            break;
        case FieldKey::SigmaDi:
            static_cast<CAppareil&>(m_element).setSigmaDi(value);
            break;
        case FieldKey::SigmaPpm:
            static_cast<CAppareil&>(m_element).setSigmaPpm(value);
            break;
        default:
            break;
        }
    }

    const CCarnet& m_carnet;
    int m_kind;
    CElement& m_element;
    std::string m_label;
};

// The edited element checked as a whole by the store's validation, as anything entering a GéoBase is:
// the element it keeps (normalised), or the reason it refuses it.
FieldChange Validated(int kind, std::unique_ptr<CElement> element) {
    ReasonCatcher catcher;
    CPyrTxtWnd txt(catcher);
    CCarnet scratch;
    const CElement* kept = nullptr;
    switch (kind) {
    case kKindStation:
        kept =
            scratch.validStation(&txt, std::unique_ptr<CStation>(static_cast<CStation*>(element.release())));
        break;
    case kKindReference:
    case kKindMesure:
        // The sighting stays where it is, behind its station: the check is of its values.
        scratch.Add(std::make_unique<CStation>("S"), kKindStation);
        if (kind == kKindReference)
            kept = scratch.validReference(
                &txt, std::unique_ptr<CReference>(static_cast<CReference*>(element.release())));
        else
            kept =
                scratch.validMesure(&txt, std::unique_ptr<CMesure>(static_cast<CMesure*>(element.release())));
        break;
    case kKindPoint:
        kept =
            scratch.validPoint(&txt, std::unique_ptr<CPointGen>(static_cast<CPointGen*>(element.release())));
        break;
    default:
        return {std::move(element), {}};
    }
    if (!kept) return {nullptr, WithoutNotAdded(catcher.text)};
    return {kept->Clone(), {}};
}

} // namespace

// ---------------------------------------------------------------- field lists

const std::vector<FieldInfo>& KindFields(int kind) {
    switch (kind) {
    case kKindComment:
        return kCommentFields;
    case kKindStation:
        return kStationFields;
    case kKindReference:
    case kKindMesure:
        return kSightingFields;
    case kKindLectAR:
    case kKindLectAV:
        return kReadingFields;
    case kKindPoint:
        return kPointFields;
    case kKindChemin:
        return kTraverseFields;
    case kKindAppareil:
        return kInstrumentFields;
    default:
        return IsCommandKind(kind) ? kCommandFields : kNoFields;
    }
}

const FieldInfo* FindField(int kind, FieldKey key) {
    for (const FieldInfo& field : KindFields(kind))
        if (field.key == key) return &field;
    return nullptr;
}

std::string_view FieldKeyName(FieldKey key) {
    for (const KeyName& entry : kKeyNames)
        if (entry.key == key) return entry.name;
    return {};
}

std::optional<FieldKey> FieldKeyFromName(std::string_view name) {
    for (const KeyName& entry : kKeyNames)
        if (EqualIgnoringCase(entry.name, name)) return entry.key;
    return std::nullopt;
}

int FieldDecimals(int kind, FieldKey key) {
    const FieldInfo* field = FindField(kind, key);
    if (!field || field->type != FieldType::Number) return -1;
    switch (key) {
    case FieldKey::HI:
        return CStation::DeciZ();
    case FieldKey::V0:
        return CStation::DeciAng();
    case FieldKey::HP:
        return CVisee::DeciZ();
    case FieldKey::AH:
    case FieldKey::AV:
        return CVisee::DeciAng();
    case FieldKey::DI:
        return CVisee::DeciXY();
    case FieldKey::Lecture:
        // A staff is read to a tenth of a millimetre, as the levelling listing shows it, whatever the
        // decimals of the altitudes.
        return std::max(CLecture::DeciZ(), kStaffReadingDecimals);
    case FieldKey::Distance:
        return CLecture::DeciXY();
    case FieldKey::X:
    case FieldKey::Y:
        return CPointGen::DeciXY();
    case FieldKey::Z:
        return CPointGen::DeciZ();
    case FieldKey::CollVerticale:
    case FieldKey::SigmaAh:
    case FieldKey::SigmaAv:
        return CAppareil::DeciAng();
    case FieldKey::ConstPrisme:
    case FieldKey::SigmaDi:
        return CAppareil::DeciXY();
    case FieldKey::SigmaPpm:
        return 1; // mm/km: a tenth is finer than any instrument's data sheet
    default:
        return -1;
    }
}

double FieldNumber(const CElement& element, int kind, FieldKey key) {
    switch (kind) {
    case kKindStation: {
        const auto& station = static_cast<const CStation&>(element);
        if (key == FieldKey::HI) return station.hi();
        if (key == FieldKey::V0) return station.v0();
        break;
    }
    case kKindReference:
    case kKindMesure: {
        const auto& sighting = static_cast<const CVisee&>(element);
        if (key == FieldKey::HP) return sighting.hp();
        if (key == FieldKey::AH) return sighting.ah();
        if (key == FieldKey::AV) return sighting.av();
        if (key == FieldKey::DI) return sighting.di();
        break;
    }
    case kKindLectAR:
    case kKindLectAV: {
        const auto& reading = static_cast<const CLecture&>(element);
        if (key == FieldKey::Lecture) return reading.lm();
        if (key == FieldKey::Distance) return reading.dist();
        break;
    }
    case kKindPoint: {
        const auto& point = static_cast<const CPointGen&>(element);
        if (key == FieldKey::X) return point.x();
        if (key == FieldKey::Y) return point.y();
        if (key == FieldKey::Z) return point.z();
        if (key == FieldKey::InvariantXY) return point.invariantXY() ? 1.0 : 0.0;
        if (key == FieldKey::InvariantZ) return point.invariantZ() ? 1.0 : 0.0;
        break;
    }
    case kKindChemin:
        if (key == FieldKey::Ferme) return static_cast<const CChemin&>(element).isClosed() ? 1.0 : 0.0;
        break;
    case kKindAppareil: {
        const auto& instrument = static_cast<const CAppareil&>(element);
        if (key == FieldKey::CollVerticale) return instrument.collVerticale();
        if (key == FieldKey::ConstPrisme) return instrument.constPrisme();
        if (key == FieldKey::SigmaAh) return instrument.sigmaAh();
        if (key == FieldKey::SigmaAv) return instrument.sigmaAv();
        if (key == FieldKey::SigmaDi) return instrument.sigmaDi();
        if (key == FieldKey::SigmaPpm) return instrument.sigmaPpm();
        break;
    }
    default:
        break;
    }
    return kUndefined;
}

std::string FieldText(const CCarnet& carnet, int index, FieldKey key) {
    const CElement* element = carnet.GetAt(index);
    if (!element) return {};
    const int kind = carnet.GetType(index);
    const FieldInfo* field = FindField(kind, key);
    if (!field) return {};
    switch (field->type) {
    case FieldType::Identifier:
        return element->mat();
    case FieldType::Flag:
        return std::string(FieldNumber(*element, kind, key) != 0.0 ? kYes : kNo);
    case FieldType::StationList:
        return Joined(static_cast<const CChemin&>(*element).stations());
    case FieldType::Number: {
        const double value = FieldNumber(*element, kind, key);
        return IsKnown(value) ? FormatFixedShown(value, FieldDecimals(kind, key)) : std::string();
    }
    case FieldType::Text:
        break;
    }
    switch (key) {
    case FieldKey::Texte:
        return static_cast<const CComment&>(*element).text();
    case FieldKey::Commande:
        return static_cast<const CCommande&>(*element).word();
    case FieldKey::Code:
        return element->sym();
    case FieldKey::Parametres:
        return element->par();
    default:
        return {};
    }
}

bool ParseTypedNumber(std::string_view text, double& value) {
    text = Trimmed(text);
    std::string plain;
    plain.reserve(text.size());
    bool comma = false;
    bool decimal = false;
    for (std::size_t i = 0; i < text.size();) {
        // Blanks are taken only between groups of three digits of the whole part: "651 200,25", not
        // "6 51.2 5" nor "- 3".
        if (const std::size_t blank = BlankAt(text, i)) {
            std::size_t digits = 0;
            while (i + blank + digits < text.size() && IsDigit(text[i + blank + digits]))
                ++digits;
            const std::size_t after = i + blank + digits;
            const bool groupEnds =
                after == text.size() || BlankAt(text, after) || text[after] == ',' || text[after] == '.';
            if (i == 0 || !IsDigit(text[i - 1]) || digits != 3 || !groupEnds || decimal) return false;
            i += blank;
            continue;
        }
        char c = text[i++];
        if (c == '.' || c == ',') decimal = true;
        if (c == ',') {
            if (comma) return false;
            comma = true;
            c = '.';
        }
        plain += c;
    }
    if (plain.empty() || !ParseDouble(plain, value)) return false;
    return std::isfinite(value);
}

FieldChange SetFieldsFromText(const CCarnet& carnet, int index, const std::vector<FieldEdit>& edits) {
    std::unique_ptr<CElement> element = carnet.copyElement(index);
    if (!element) return {nullptr, Sprintf(kNoElement, index + 1)};
    const int kind = carnet.GetType(index);
    FieldSetter setter(carnet, kind, *element);
    for (const FieldEdit& edit : edits) {
        std::string error = setter.Set(edit.key, edit.text);
        if (!error.empty()) return {nullptr, std::move(error)};
    }
    return Validated(kind, std::move(element));
}

FieldChange SetFieldFromText(const CCarnet& carnet, int index, FieldKey key, std::string_view text) {
    return SetFieldsFromText(carnet, index, {FieldEdit{key, std::string(text)}});
}

} // namespace pyr
