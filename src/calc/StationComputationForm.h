#pragma once

#include "calc/SightingComputationForm.h"
#include "calc/StationComputation.h"

namespace pyr {

// The window of a station computed from its sightings: the station chosen in the combo, the results X,
// Y, V0 and Z with their EMQ (X and Y in the surveyor's order), and the button that writes the station.
class CStationComputationForm : public CSightingComputationForm {
public:
    // The result lines.
    enum Line : int { kLineFirst, kLineSecond, kLineV0, kLineZ };

    CStationComputationForm(const ui::DialogModel& dialog, CStationComputation& model)
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

    CStationComputation& m_model;
};

} // namespace pyr
