#include "calc/StationReductionDriver.h"

#include "calc/StationReductionForm.h"
#include "core/Strings.h"

#include <string_view>

namespace pyr {

namespace {

// A check box's text as a line of help: without its shortcut mark and its trailing blank.
std::string HelpText(std::string_view checkBox) {
    std::string text;
    for (char c : checkBox)
        if (c != '&') text += c;
    return std::string(Trimmed(text));
}

} // namespace

void CReductionDriver::DeclareOptions(ui::DialogOptions& options) {
    const std::span<const ReductionSwitch> switches = ReductionSwitches();
    for (std::size_t i = 0; i < switches.size(); ++i)
        options.ZeroOrOne(switches[i].key, HelpText(switches[i].checkBox),
                          [this, i](bool on) { m_given[i] = on; });
}

ui::DialogResult CReductionDriver::Run(ui::FrontEnd& frontEnd) {
    m_model.SetInputs(Inputs());
    if (GeoBaseNamed()) m_model.SetGeoBase(GeoBase());
    if (!m_model.Carnet()) return ui::DialogResult::Failed;
    for (std::size_t i = 0; i < m_given.size(); ++i)
        if (m_given[i]) m_model.GiveSwitch(i, *m_given[i]);
    m_model.OnInitDialog();
    m_model.OnOK(frontEnd);
    return ui::DialogResult::Ok;
}

std::unique_ptr<ui::Form> CReductionDriver::MakeForm() {
    return std::make_unique<CStationReductionForm>(*this, m_model);
}

} // namespace pyr
