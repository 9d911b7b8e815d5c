#pragma once

#include "calc/CalcInters.h"
#include "calc/SightingComputationForm.h"

namespace pyr {

// The window of points by intersection: the point chosen in the combo, the results X, Y and Z with
// their EMQ in the surveyor's order of the axes, and the button that writes the point.
class CCalcIntersForm : public CSightingComputationForm {
public:
    // The result lines.
    enum Line : int { kLineFirst, kLineSecond, kLineZ };

    CCalcIntersForm(const ui::DialogModel& dialog, CCalcInters& model)
        : CSightingComputationForm(dialog, model), m_model(model) {}

private:
    bool OpenModel(ui::FrontEnd& frontEnd) override { return m_model.Open(frontEnd); }
    const char* SubjectLabel() const override { return "&Point :"; }
    const char* WriteLabel() const override { return "É&crire le point"; }
    std::vector<std::string> Subjects() const override { return m_model.Points(); }
    std::string Subject() const override { return m_model.Point(); }
    bool ChooseSubject(const std::string& subject) override { return m_model.ChoosePoint(subject); }
    std::vector<ResultLine> ResultLines() const override;
    std::string Status() const override { return m_model.Status(); }
    bool CanWrite() const override { return m_model.CanWrite(); }
    bool Write() override { return m_model.WritePoint(); }
    bool CanFinish() const override { return m_model.CanFinish(); }

    CCalcInters& m_model;
};

} // namespace pyr
