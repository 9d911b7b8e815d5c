#include "calc/CalcIntersForm.h"

#include "calc/IntersectionTexts.h"
#include "core/Strings.h"
#include "geobase/Elements.h"
#include "ui/FormControls.h"

#include <algorithm>

namespace pyr {

namespace {

using ui::Ctl;

using ui::Control;
using ui::ControlKind;

constexpr const char* kLabelEmq = "EMQ";
constexpr const char* kTextZ = "Z =";

std::vector<std::string> Texts(const std::vector<CCalcInters::Line>& lines) {
    std::vector<std::string> texts;
    texts.reserve(lines.size());
    for (const auto& line : lines)
        texts.push_back(line.text);
    return texts;
}

std::vector<std::string> Tips(const std::vector<CCalcInters::Line>& lines) {
    std::vector<std::string> tips;
    tips.reserve(lines.size());
    for (const auto& line : lines)
        tips.push_back(line.tooltip);
    return tips;
}

} // namespace

std::vector<ui::Control> CCalcIntersForm::Controls() const {
    // Two lists side by side with the arrows between them, the switches under them, then the results in
    // a frame: a coordinate and its EMQ on each line.
    using K = ControlKind;
    const bool swap = CPointGen::SwapXY();
    std::vector<Control> controls{
        Ctl(kLabelPoint, K::Label, "etiquettePoint", "&Point :").Buddy(kPoint),
        Ctl(kPoint, K::EditCombo, "point").At(0, 1).Width(12),
        Ctl(kLabelAvailable, K::Label, "etiquetteDisponibles", "Visées &disponibles :")
            .At(1, 0, 1, 2)
            .Buddy(kAvailable),
        Ctl(kAvailable, K::List, "disponibles").At(2, 0, 4, 2).Width(20).Lines(8),
        Ctl(kAddOne, K::Button, "ajouterUne", "&Ajouter >").At(2, 2),
        Ctl(kAddAll, K::Button, "ajouterToutes", "Ajouter t&out >>").At(3, 2),
        Ctl(kRemoveOne, K::Button, "retirerUne", "< &Retirer").At(4, 2),
        Ctl(kRemoveAll, K::Button, "retirerToutes", "<< Retirer to&us").At(5, 2),
        Ctl(kLabelSelected, K::Label, "etiquetteRetenues", "Visées rete&nues :")
            .At(1, 3, 1, 2)
            .Buddy(kSelected),
        Ctl(kSelected, K::List, "retenues").At(2, 3, 4, 2).Width(20).Lines(8),
        Ctl(kPlani, K::Check, "calculPlani", "Calcul en p&lanimétrie").At(6, 0, 1, 2),
        Ctl(kAlti, K::Check, "calculAlti", "Calcul en al&timétrie").At(6, 3, 1, 2),
        Ctl(kResults, K::Group, "resultat", "Résultat").At(7, 0, 1, 5),
    };
    const struct {
        int label, field, emqLabel, emq;
        const char* name;
        const char* text;
    } lines[] = {
        // The names say the place, the labels the axis: X or Y first as the options show them.
        {kLabelFirst, kFirst, kLabelEmqFirst, kEmqFirst, "Premiere",
         swap ? inters::kLabelY : inters::kLabelX},
        {kLabelSecond, kSecond, kLabelEmqSecond, kEmqSecond, "Seconde",
         swap ? inters::kLabelX : inters::kLabelY},
        {kLabelZ, kZ, kLabelEmqZ, kEmqZ, "Altitude", kTextZ},
    };
    int row = 0;
    for (const auto& line : lines) {
        const std::string name = line.name;
        controls.push_back(Ctl(line.label, K::Label, "etiquette" + name, line.text)
                               .In(kResults)
                               .At(row, 0)
                               .Buddy(line.field));
        controls.push_back(Ctl(line.field, K::Field, "coordonnee" + name).In(kResults).At(row, 1).Width(14));
        controls.push_back(Ctl(line.emqLabel, K::Label, "etiquetteEmq" + name, kLabelEmq)
                               .In(kResults)
                               .At(row, 2)
                               .Buddy(line.emq));
        controls.push_back(Ctl(line.emq, K::Field, "emq" + name).In(kResults).At(row, 3).Width(8));
        ++row;
    }
    controls.push_back(Ctl(kStatus, K::Status, "etat").At(8, 0, 1, 5));
    controls.push_back(Ctl(kWrite, K::Button, "ecrire", "É&crire le point").At(9, 0, 1, 2));
    controls.push_back(Ctl(ui::kIdOk, K::Button, "finListing", "Fin + Listing").In(ui::kButtonRow).Default());
    controls.push_back(Ctl(ui::kIdCancel, K::Button, "fermer", "&Fermer").In(ui::kButtonRow).At(0, 1));
    return controls;
}

bool CCalcIntersForm::Open(ui::FrontEnd& frontEnd) {
    m_model.SetInputs(m_dialog.Inputs());
    if (m_dialog.GeoBaseNamed()) m_model.SetGeoBase(m_dialog.GeoBase());
    if (m_model.Open(frontEnd)) return true;
    // No GéoBase chosen is a cancel; any other refusal was told by a message.
    End(m_model.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed);
    return false;
}

ui::ControlState CCalcIntersForm::State(int id) const {
    ui::ControlState state;
    const bool swap = CPointGen::SwapXY();
    switch (id) {
    case kPoint: {
        const auto& points = m_model.Points();
        state.items = points;
        state.text = m_model.Point();
        const auto found = std::find(points.begin(), points.end(), m_model.Point());
        if (!m_model.Point().empty() && found != points.end())
            state.current = static_cast<int>(found - points.begin());
        break;
    }
    case kAvailable:
        state.items = Texts(m_model.Available());
        state.tips = Tips(m_model.Available());
        state.current = m_model.HighlightedAvailable();
        break;
    case kSelected:
        state.items = Texts(m_model.Selected());
        state.tips = Tips(m_model.Selected());
        state.current = m_model.HighlightedSelected();
        break;
    case kAddOne:
        state.enabled = m_model.CanAddOne();
        break;
    case kAddAll:
        state.enabled = m_model.CanAddAll();
        break;
    case kRemoveOne:
        state.enabled = m_model.CanRemoveOne();
        break;
    case kRemoveAll:
        state.enabled = m_model.CanRemoveAll();
        break;
    case kPlani:
        state.checked = m_model.Plani();
        break;
    case kAlti:
        state.checked = m_model.Alti();
        break;
    case kLabelFirst:
        state.text = swap ? inters::kLabelY : inters::kLabelX;
        break;
    case kLabelSecond:
        state.text = swap ? inters::kLabelX : inters::kLabelY;
        break;
    case kFirst:
        state.text = swap ? m_model.YText() : m_model.XText();
        break;
    case kSecond:
        state.text = swap ? m_model.XText() : m_model.YText();
        break;
    case kEmqFirst:
        state.text = swap ? m_model.EmqYText() : m_model.EmqXText();
        break;
    case kEmqSecond:
        state.text = swap ? m_model.EmqXText() : m_model.EmqYText();
        break;
    case kZ:
        state.text = m_model.ZText();
        break;
    case kEmqZ:
        state.text = m_model.EmqZText();
        break;
    case kStatus:
        state.text = m_model.Status();
        break;
    case kWrite:
        state.enabled = m_model.CanWrite();
        break;
    case ui::kIdOk:
        state.enabled = m_model.CanFinish();
        break;
    default:
        break;
    }
    return state;
}

void CCalcIntersForm::Moved() {
    if (m_model.CanFinish()) Focus(ui::kIdOk);
}

void CCalcIntersForm::Act(ui::FrontEnd&, int id, const ui::Event& event) {
    using ui::EventKind;
    switch (id) {
    case kPoint: {
        const auto& points = m_model.Points();
        std::string mat;
        if (event.kind == EventKind::Select && event.rank >= 0 &&
            event.rank < static_cast<int>(points.size()))
            mat = points[static_cast<std::size_t>(event.rank)];
        else if (event.kind == EventKind::Text)
            mat = Trimmed(event.text);
        // The point shown again keeps the sightings taken.
        if (mat.empty() || mat == m_model.Point()) return;
        if (m_model.ChoosePoint(mat)) Focus(kAvailable);
        return;
    }
    case kAvailable:
        if (event.kind == EventKind::Select || event.kind == EventKind::Activate)
            m_model.HighlightAvailable(event.rank);
        if (event.kind == EventKind::Activate && m_model.CanAddOne()) {
            m_model.AddOne();
            Moved();
        }
        return;
    case kSelected:
        if (event.kind == EventKind::Select || event.kind == EventKind::Activate)
            m_model.HighlightSelected(event.rank);
        if (event.kind == EventKind::Activate && m_model.CanRemoveOne()) {
            m_model.RemoveOne();
            Moved();
        }
        return;
    case kAddOne:
        m_model.AddOne(), Moved();
        return;
    case kAddAll:
        m_model.AddAll(), Moved();
        return;
    case kRemoveOne:
        m_model.RemoveOne(), Moved();
        return;
    case kRemoveAll:
        m_model.RemoveAll(), Moved();
        return;
    case kPlani:
        if (event.kind == EventKind::Check) m_model.SetPlani(event.on);
        return;
    case kAlti:
        if (event.kind == EventKind::Check) m_model.SetAlti(event.on);
        return;
    case kWrite:
        if (m_model.WritePoint()) m_written = true;
        return;
    case ui::kIdOk:
        if (!m_model.CanFinish()) return;
        m_model.FinishWithListing();
        End(ui::DialogResult::Ok);
        return;
    case ui::kIdCancel:
        m_model.Close();
        End(m_written ? ui::DialogResult::Ok : ui::DialogResult::Cancel);
        return;
    default:
        return;
    }
}

} // namespace pyr
