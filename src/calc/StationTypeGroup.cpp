#include "calc/StationTypeGroup.h"

#include "core/Strings.h"
#include "ui/FormControls.h"

namespace pyr {

std::vector<ui::Control> StationTypeGroup::Controls() const {
    using K = ui::ControlKind;
    using ui::Ctl;
    return {
        Ctl(Group(), K::Group, "typeDeCalcul", "&Type de calcul :").At(0, 0, 1, 4),
        Ctl(Unique(), K::Radio, "unique", "Unique").In(Group()),
        Ctl(Liste(), K::Radio, "liste", "Liste").In(Group()).At(0, 1),
        Ctl(Toutes(), K::Radio, "toutes", "Toutes").In(Group()).At(0, 2),
        Ctl(ListLabel(), K::Label, "etiquetteStationsListe", "Stations de la l&iste :")
            .In(Group())
            .At(1, 0)
            .Buddy(List()),
        Ctl(List(), K::Edit, "stationsListe").In(Group()).At(1, 1, 1, 2).Width(20),
    };
}

ui::ControlState StationTypeGroup::State(int id, V0CalculationType type, const std::string& list) const {
    ui::ControlState state;
    if (id == Unique()) state.checked = type == V0CalculationType::Unique;
    if (id == Liste()) state.checked = type == V0CalculationType::Liste;
    if (id == Toutes()) state.checked = type == V0CalculationType::Toutes;
    if (id == ListLabel() || id == List()) state.enabled = type == V0CalculationType::Liste;
    if (id == List()) state.text = list;
    return state;
}

std::optional<V0CalculationType> StationTypeGroup::Chosen(int id, const ui::Event& event) const {
    if (event.kind != ui::EventKind::Check || !event.on) return std::nullopt;
    if (id == Unique()) return V0CalculationType::Unique;
    if (id == Liste()) return V0CalculationType::Liste;
    if (id == Toutes()) return V0CalculationType::Toutes;
    return std::nullopt;
}

std::optional<std::string> StationTypeGroup::TypedList(int id, const ui::Event& event) const {
    if (id != List() || event.kind != ui::EventKind::Text) return std::nullopt;
    return std::string(Trimmed(event.text));
}

} // namespace pyr
