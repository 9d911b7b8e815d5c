#include "calc/CalculV0Form.h"

#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "ui/FormControls.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <utility>

namespace pyr {

namespace {

using ui::Ctl;

using ui::Control;
using ui::ControlKind;

constexpr const char* kMsgNotANumber = "« %s » n'est pas un nombre !";
constexpr const char* kColumns[] = {"Référence", "Gis.", "DH", "AH", "V0", "eV0 Gr"};

std::string Fixed(double value, int decimals) {
    return IsKnown(value) ? FormatFixedShown(value, decimals) : std::string();
}

// An angle of the GéoBase's decimals; a direction or a bearing in [0, 400), a full turn shown as 0.
std::string Angle(double grads, bool wrap = false) {
    if (!IsKnown(grads)) return {};
    const int decimals = CStation::DeciAng();
    if (wrap) {
        grads = WrapGrads(grads);
        if (RoundToDecimals(grads, decimals) >= 400.0) grads = 0.0;
    }
    return FormatFixedShown(grads, decimals);
}

std::string Cell(std::string text) {
    return text.empty() ? std::string("-") : text;
}

// A number typed by a person: the decimal comma of a French keyboard is read as a point.
bool ReadTyped(std::string_view text, double& value) {
    std::string typed(Trimmed(text));
    std::replace(typed.begin(), typed.end(), ',', '.');
    return ParseDouble(typed, value);
}

} // namespace

std::vector<ui::Control> CCalculV0Form::Controls() const {
    using K = ControlKind;
    const bool swap = CPointGen::SwapXY();
    std::vector<ui::Control> controls{
        // The station and its coordinates one above the other, the references it offers beside them;
        // under them, the references as the computation left them, across the whole dialog.
        Ctl(kLabelStation, K::Label, "etiquetteStation", "&Station :").At(1, 0).Buddy(kStation),
        Ctl(kStation, K::Combo, "station").At(1, 1).Width(12),
        // The names say the place, the labels the axis: X or Y first as the options show them.
        Ctl(kLabelFirst, K::Label, "etiquettePremiere", swap ? "&Y :" : "&X :").At(2, 0).Buddy(kFirst),
        Ctl(kFirst, K::Edit, "coordonneePremiere").At(2, 1).Width(12),
        Ctl(kLabelSecond, K::Label, "etiquetteSeconde", swap ? "&X :" : "&Y :").At(3, 0).Buddy(kSecond),
        Ctl(kSecond, K::Edit, "coordonneeSeconde").At(3, 1).Width(12),
        Ctl(kLabelZ, K::Label, "etiquetteAltitude", "&Z :").At(4, 0).Buddy(kZ),
        Ctl(kZ, K::Edit, "altitude").At(4, 1).Width(12),
        Ctl(kLabelReferences, K::Label, "etiquetteReferences", "&Références :").At(1, 2).Buddy(kReferences),
        Ctl(kReferences, K::CheckList, "references").At(1, 3, 4, 1).Width(14).Lines(4),

        Ctl(kLabelResults, K::Label, "etiquetteResultats", "Rés&ultats :").At(5, 0, 1, 4).Buddy(kResults),
        Ctl(kResults, K::List, "resultats")
            .At(6, 0, 1, 4)
            .Columns({std::begin(kColumns), std::end(kColumns)})
            .Width(66)
            .Lines(6),
        Ctl(kWeighted, K::Check, "ponderation", "&Pondérer par les distances").At(7, 0, 1, 2),
        Ctl(kForced, K::Check, "forcer", "&Forcer l'utilisation des réf. choisies").At(7, 2, 1, 2),

        Ctl(kHand, K::Group, "entreeV0", "Entrée du V0 de la station").At(8, 0, 1, 4),
        Ctl(kLabelPrevious, K::Label, "etiquetteV0Precedent", "Valeur précédente du V0 :")
            .In(kHand)
            .Buddy(kPrevious),
        Ctl(kPrevious, K::Field, "v0Precedent").In(kHand).At(0, 1).Width(10),
        Ctl(kLabelFixed, K::Label, "etiquetteV0Fixe", "Va&leur fixée pour le V0 :")
            .In(kHand)
            .At(0, 2)
            .Buddy(kFixed),
        Ctl(kFixed, K::Edit, "v0Fixe").In(kHand).At(0, 3).Width(10),

        Ctl(kLabelV0, K::Label, "etiquetteV0", "&V0 :").At(9, 0).Buddy(kV0),
        Ctl(kV0, K::Field, "v0").At(9, 1).Width(10),
        Ctl(kCalculate, K::Button, "calculer", "&Calculer").At(9, 2).Default(),
        Ctl(kGraphic, K::Button, "graphique", "&Graphique").At(9, 3),
        Ctl(ui::kIdOk, K::Button, "enregistrer", "&Enregistrer").In(ui::kButtonRow),
        Ctl(ui::kIdCancel, K::Button, "annuler", "Annuler").In(ui::kButtonRow).At(0, 1),
    };
    const std::vector<ui::Control> type = kTypeGroup.Controls();
    controls.insert(controls.begin(), type.begin(), type.end());
    return controls;
}

bool CCalculV0Form::Open(ui::FrontEnd& frontEnd) {
    m_model.SetInputs(m_dialog.Inputs());
    if (m_dialog.GeoBaseNamed()) m_model.SetGeoBase(m_dialog.GeoBase());
    if (m_model.Open(frontEnd)) return true;
    // No GéoBase chosen is a cancel; any other refusal was told by a message.
    End(m_model.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed);
    return false;
}

CCalculV0Form::Axis CCalculV0Form::AxisOf(int id) {
    const bool swap = CPointGen::SwapXY();
    if (id == kFirst) return swap ? kAxisY : kAxisX;
    if (id == kSecond) return swap ? kAxisX : kAxisY;
    return kAxisZ;
}

std::string CCalculV0Form::CoordinateText(Axis axis) const {
    const StationPlace& station = m_model.Station();
    const double values[] = {station.x, station.y, station.z};
    const double value = m_typed[axis].value_or(values[axis]);
    return Fixed(value, axis == kAxisZ ? CPointGen::DeciZ() : CPointGen::DeciXY());
}

ui::ControlState CCalculV0Form::State(int id) const {
    ui::ControlState state;
    const V0CalculationType type = m_model.Type();
    const bool unique = type == V0CalculationType::Unique;
    const StationPlace& station = m_model.Station();
    const V0Result* result = m_model.StationResult();
    const bool swap = CPointGen::SwapXY();
    if (kTypeGroup.Holds(id)) return kTypeGroup.State(id, type, m_model.List());
    switch (id) {
    case kStation:
        state.items = m_model.Stations();
        state.current = m_model.StationRank();
        break;
    case kLabelFirst:
        state.text = swap ? "&Y :" : "&X :";
        break;
    case kLabelSecond:
        state.text = swap ? "&X :" : "&Y :";
        break;
    case kFirst:
    case kSecond:
    case kZ:
        // Typed only for a station that the GéoBase does not place.
        state.enabled = unique && station.index >= 0 && !std::as_const(m_model).Carnet().hasXY(station.name);
        state.text = CoordinateText(AxisOf(id));
        break;
    case kReferences:
        state.enabled = unique;
        for (const auto& offered : m_model.References()) {
            state.items.push_back(offered.mat);
            state.checks.push_back(offered.chosen);
        }
        break;
    case kResults:
        if (result && !result->byHand)
            for (const V0Reference& ref : result->references)
                state.items.push_back(ref.mat + '\t' + Cell(Angle(ref.bearing, true)) + '\t' +
                                      Cell(Fixed(ref.distance, CPointGen::DeciXY())) + '\t' +
                                      Cell(Angle(ref.ah, true)) + '\t' + Cell(Angle(ref.partialV0, true)) +
                                      '\t' + Cell(Angle(ref.residual)));
        break;
    case kWeighted:
        state.checked = m_model.Weighted();
        break;
    case kForced:
        state.checked = m_model.Forced();
        break;
    case kPrevious:
        state.text = station.IsOriented() ? Angle(station.v0, true) : std::string();
        break;
    case kLabelFixed:
    case kFixed:
        state.enabled = unique && station.index >= 0;
        if (id == kFixed && result && result->byHand) state.text = Angle(result->v0, true);
        break;
    case kV0:
        state.text = Angle(m_model.V0(), true);
        break;
    case kCalculate:
        state.enabled = type == V0CalculationType::Toutes ||
                        (type == V0CalculationType::Liste ? !m_model.List().empty() : station.index >= 0);
        break;
    case kGraphic:
        state.enabled = false;
        break; // the stations are drawn in the GéoBase editor's view
    default:
        break;
    }
    return state;
}

void CCalculV0Form::TypeCoordinate(ui::FrontEnd& frontEnd, Axis axis, const std::string& text) {
    if (Trimmed(text).empty()) {
        m_typed[axis].reset();
        return;
    }
    if (text == CoordinateText(axis)) return; // left without a change
    double value = 0.0;
    if (!ReadTyped(text, value)) {
        frontEnd.MessageBox(Sprintf(kMsgNotANumber, text.c_str()), ui::kCaption, ui::kIconWarning);
        return;
    }
    m_typed[axis] = value;
    // X and Y go together: the station is placed once both are there.
    const StationPlace& station = m_model.Station();
    const double x = m_typed[kAxisX].value_or(station.x), y = m_typed[kAxisY].value_or(station.y);
    const double z = m_typed[kAxisZ].value_or(station.z);
    if (IsKnown(x) && IsKnown(y) && m_model.SetStationCoordinates(x, y, z)) m_typed = {};
}

void CCalculV0Form::TypeV0(ui::FrontEnd& frontEnd, const std::string& text) {
    if (Trimmed(text).empty() || text == State(kFixed).text) return;
    double v0 = 0.0;
    if (!ReadTyped(text, v0)) {
        frontEnd.MessageBox(Sprintf(kMsgNotANumber, text.c_str()), ui::kCaption, ui::kIconWarning);
        return;
    }
    m_model.EnterV0(v0);
}

void CCalculV0Form::Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) {
    using ui::EventKind;
    if (const std::optional<V0CalculationType> type = kTypeGroup.Chosen(id, event)) {
        m_model.SetType(*type);
        return;
    }
    if (const std::optional<std::string> list = kTypeGroup.TypedList(id, event)) {
        if (*list != m_model.List()) m_model.SetList(*list);
        return;
    }
    if (kTypeGroup.Holds(id)) return;
    switch (id) {
    case kStation: {
        const auto& stations = m_model.Stations();
        if (event.kind != EventKind::Select || event.rank < 0 ||
            event.rank >= static_cast<int>(stations.size()) || event.rank == m_model.StationRank())
            return;
        m_typed = {};
        m_model.ChooseStation(stations[static_cast<std::size_t>(event.rank)]);
        return;
    }
    case kFirst:
    case kSecond:
    case kZ:
        if (event.kind == EventKind::Text) TypeCoordinate(frontEnd, AxisOf(id), event.text);
        return;
    case kReferences:
        if (event.kind == EventKind::CheckLine && event.rank >= 0)
            m_model.ChooseReference(static_cast<std::size_t>(event.rank), event.on);
        return;
    case kWeighted:
        if (event.kind == EventKind::Check) m_model.SetWeighted(event.on);
        return;
    case kForced:
        if (event.kind == EventKind::Check) m_model.SetForced(event.on);
        return;
    case kFixed:
        if (event.kind == EventKind::Text) TypeV0(frontEnd, event.text);
        return;
    case kCalculate:
        if (State(kCalculate).enabled) m_model.Calculate();
        return;
    case ui::kIdOk: {
        // The V0 found go into their stations and the GéoBase is saved; a GéoBase that could not be saved
        // ends the dialog as a failure, the message having said why.
        const bool saved = m_model.Enregistrer();
        m_model.Close(saved);
        End(saved ? ui::DialogResult::Ok : ui::DialogResult::Failed);
        return;
    }
    case ui::kIdCancel:
        m_model.Close(false);
        End(ui::DialogResult::Cancel);
        return;
    default:
        return;
    }
}

} // namespace pyr
