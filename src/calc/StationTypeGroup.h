#pragma once

#include "calc/CalculV0Sta.h"
#include "ui/Form.h"

#include <optional>
#include <string>
#include <vector>

namespace pyr {

// The radio group "&Type de calcul :" of the windows that work on one station, the stations of a list or
// all of them: its six controls hold consecutive ids from `first` (the group, the radios "Unique", "Liste"
// and "Toutes", the label and the edit of the list).
struct StationTypeGroup {
    int first;

    int Group() const { return first; }
    int Unique() const { return first + 1; }
    int Liste() const { return first + 2; }
    int Toutes() const { return first + 3; }
    int ListLabel() const { return first + 4; }
    int List() const { return first + 5; }
    bool Holds(int id) const { return id >= first && id <= List(); }

    std::vector<ui::Control> Controls() const;
    // The state of one of its controls, for that type and list.
    ui::ControlState State(int id, V0CalculationType type, const std::string& list) const;
    // The type a radio set by the person chooses; nothing for any other event.
    std::optional<V0CalculationType> Chosen(int id, const ui::Event& event) const;
    // The list committed in its edit, trimmed; nothing for any other event.
    std::optional<std::string> TypedList(int id, const ui::Event& event) const;
};

} // namespace pyr
