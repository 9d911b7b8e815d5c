#pragma once

#include "calc/CalcExcent.h"
#include "calc/SightingComputationForm.h"

namespace pyr {

// The window of an eccentric station: the station chosen in the combo, its centre in a second combo
// beside it, the results X, Y and V0 (no error: one sighting places the station) and Z with the error of
// the altitude from the references, and the button that writes the station.
class CCalcExcentForm : public CSightingComputationForm {
public:
    // The result lines.
    enum Line : int { kLineFirst, kLineSecond, kLineV0, kLineZ };
    // The controls of the centre.
    enum Own : int { kLabelCentre = kFirstOwn, kCentre };

    CCalcExcentForm(const ui::DialogModel& dialog, CCalcExcent& model)
        : CSightingComputationForm(dialog, model), m_model(model) {}

private:
    bool OpenModel(ui::FrontEnd& frontEnd) override { return m_model.Open(frontEnd); }
    const char* SubjectLabel() const override { return "&Station :"; }
    const char* WriteLabel() const override { return "É&crire la station"; }
    std::vector<std::string> Subjects() const override { return m_model.Stations(); }
    std::string Subject() const override { return m_model.Station(); }
    bool ChooseSubject(const std::string& subject) override { return m_model.ChooseStation(subject); }
    std::vector<ResultLine> ResultLines() const override;
    std::string Status() const override { return m_model.Status(); }
    bool CanWrite() const override { return m_model.CanWrite(); }
    bool Write() override { return m_model.WriteStation(); }
    bool CanFinish() const override { return m_model.CanFinish(); }
    void AddOwnControls(std::vector<ui::Control>& controls) const override;
    ui::ControlState OwnState(int id) const override;
    void OwnAct(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

    CCalcExcent& m_model;
};

} // namespace pyr
