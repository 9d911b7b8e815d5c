#include "calc/CalculV0Driver.h"

#include "calc/CalculV0Form.h"
#include "calc/CalculV0Texts.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Selection.h"
#include "settings/ListingFlow.h"
#include "ui/FrontEnd.h"

namespace pyr {

namespace {

constexpr const char* kHelpType = "le type de calcul : une station, les stations d'une liste, toutes les "
                                  "stations (par défaut, celui de la dernière fois) ; en liste et toutes, "
                                  "chaque station prend ses visées de référence";
constexpr const char* kHelpStation = "la station à orienter, S1 ou S1(2) pour sa deuxième reprise (calcul "
                                     "unique ; par défaut la première station)";
constexpr const char* kHelpReferences = "les points de référence à utiliser (par défaut les visées de "
                                        "référence de la station)";
constexpr const char* kHelpCoordinate = " de la station, quand la GéoBase ne la connaît pas";
constexpr const char* kHelpList = "les stations à orienter, toutes leurs reprises (calcul d'une liste) ; "
                                  "celles sans coordonnées ou sans référence valide sont nommées et comptées";
constexpr const char* kHelpWeighting = "la moyenne pondérée par les distances (1) ou non (0)";
constexpr const char* kHelpForce = "garder toutes les références choisies, même hors tolérance";
constexpr const char* kHelpV0 = "le V0 de la station fixé à la main (grades), écrit comme un V0 calculé";
constexpr const char* kHelpSave = "écrire les V0 dans les stations et enregistrer la GéoBase (avec des "
                                  "coordonnées tapées, propose d'y ajouter le point de la station)";

// A number of an option, or the French reason it is not one.
std::string ReadNumber(const char* option, const std::string& text, std::optional<double>& value) {
    double number = 0;
    if (!ParseDouble(text, number)) return Sprintf(v0::kBadNumber, option, text.c_str());
    value = number;
    return {};
}

} // namespace

void CCalculV0Driver::DeclareOptions(ui::DialogOptions& options) {
    using Type = V0CalculationType;
    DeclareTypeOption(options, m_requests.choice, kHelpType);
    DeclareStationOption(options, m_requests.choice, kHelpStation);
    options.Value("references", "SELECTION", kHelpReferences, [this](const std::string& selection) {
        if (!IsValidSelString(selection)) return std::string(msg::kNoSelection);
        m_requests.references = selection;
        return std::string();
    });
    const struct {
        const char* name;
        const char* valueName;
        std::optional<double>* value;
    } coordinates[] = {{"x", "X", &m_requests.x}, {"y", "Y", &m_requests.y}, {"z", "Z", &m_requests.z}};
    for (const auto& [name, valueName, value] : coordinates)
        options.Value(name, valueName, valueName + std::string(kHelpCoordinate),
                      [this, name = name, value = value](const std::string& text) {
                          m_requests.choice.type = Type::Unique;
                          return ReadNumber(name, text, *value);
                      });
    DeclareListOption(options, m_requests.choice, kHelpList);
    options.ZeroOrOne("ponderation", kHelpWeighting,
                      [this](bool weighted) { m_requests.weighted = weighted; });
    options.Switch("forcer", kHelpForce, [this] {
        m_requests.forced = true;
        return std::string();
    });
    options.Value("v0", "VALEUR", kHelpV0, [this](const std::string& text) {
        m_requests.choice.type = Type::Unique;
        return ReadNumber("v0", text, m_requests.v0);
    });
    DeclareComputationOptions(options, m_requests.computation, kHelpSave);
}

bool CCalculV0Driver::ApplyRequests(ui::FrontEnd& frontEnd) {
    CCalculV0Sta& v0 = m_model;
    if (m_requests.choice.station && !v0.ChooseStation(*m_requests.choice.station)) return false;
    if ((m_requests.x || m_requests.y || m_requests.z) &&
        !v0.SetStationCoordinates(m_requests.x.value_or(kUndefined), m_requests.y.value_or(kUndefined),
                                  m_requests.z.value_or(kUndefined)))
        return false;
    if (m_requests.references && !v0.ChooseReferences(*m_requests.references)) return false;
    if (m_requests.v0 && v0.Type() != V0CalculationType::Unique) {
        frontEnd.MessageBox(v0::kMsgHandV0OnlyUnique, ui::kCaption, ui::kIconWarning);
        return false;
    }
    return true;
}

ui::DialogResult CCalculV0Driver::Run(ui::FrontEnd& frontEnd) {
    CCalculV0Sta& v0 = m_model;
    v0.SetInputs(Inputs());
    if (GeoBaseNamed()) v0.SetGeoBase(GeoBase());
    if (m_requests.choice.type) v0.SetType(*m_requests.choice.type);
    if (m_requests.weighted) v0.SetWeighted(*m_requests.weighted);
    if (m_requests.forced) v0.SetForced(true);
    if (m_requests.choice.list) v0.SetList(*m_requests.choice.list);
    if (!v0.Open(frontEnd)) return v0.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed;
    if (!ApplyRequests(frontEnd)) return ui::DialogResult::Failed;
    const bool done = m_requests.v0 ? v0.EnterV0(*m_requests.v0) : v0.Calculate();
    const bool saved = done && m_requests.computation.save && v0.Enregistrer();
    v0.Close(saved, m_requests.computation.listing, m_requests.computation.listingPath);
    return done && (saved || !m_requests.computation.save) ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

std::unique_ptr<ui::Form> CCalculV0Driver::MakeForm() {
    return std::make_unique<CCalculV0Form>(*this, m_model);
}

} // namespace pyr
