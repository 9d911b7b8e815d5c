#pragma once

#include "calc/CalculV0Sta.h"
#include "calc/StationTypeGroup.h"
#include "ui/Form.h"

#include <array>
#include <optional>

namespace pyr {

// The window of the orientation of stations: the type of calculation, the list of stations for "Liste",
// the station and its coordinates (typed when the GéoBase does not place it), the references to choose,
// the chosen station's references as the computation left them, the two switches of the mean, the V0
// before and fixed by hand, the V0 found; "&Calculer", and "&Enregistrer" which writes and closes.
class CCalculV0Form : public ui::Form {
public:
    enum Id : int {
        kType = 3,
        kUnique,
        kListe,
        kToutes,
        kLabelList,
        kList,
        kLabelStation,
        kStation,
        kLabelFirst, // "&X :" or "&Y :", as the axes are shown
        kFirst,
        kLabelSecond,
        kSecond,
        kLabelZ,
        kZ,
        kLabelReferences,
        kReferences,
        kLabelResults,
        kResults,
        kWeighted,
        kForced,
        kHand,
        kLabelPrevious,
        kPrevious,
        kLabelFixed,
        kFixed,
        kLabelV0,
        kV0,
        kCalculate,
        kGraphic,
    };
    // "&Type de calcul :", from kType to kList.
    static constexpr StationTypeGroup kTypeGroup{kType};

    // `dialog` gives the command's inputs when the window opens; `model` is the dialog shown.
    CCalculV0Form(const ui::DialogModel& dialog, CCalculV0Sta& model) : m_dialog(dialog), m_model(model) {}

    ui::DialogModel& Model() override { return m_model; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

private:
    enum Axis { kAxisX, kAxisY, kAxisZ };
    // The axis a coordinate field shows.
    static Axis AxisOf(int id);
    std::string CoordinateText(Axis axis) const;
    void TypeCoordinate(ui::FrontEnd& frontEnd, Axis axis, const std::string& text);
    void TypeV0(ui::FrontEnd& frontEnd, const std::string& text);

    const ui::DialogModel& m_dialog;
    CCalculV0Sta& m_model;
    // Coordinates typed for a station the GéoBase does not place, until X and Y are both there.
    std::array<std::optional<double>, 3> m_typed;
};

} // namespace pyr
