#include "calc/ChangeRepDriver.h"

#include "calc/ChangeRepForm.h"
#include "calc/ChangeRepTexts.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "ui/FrontEnd.h"

#include <cmath>
#include <string_view>

namespace pyr {

namespace {

// "XA,YA,XB,YB": four numbers, else nothing.
std::optional<std::array<std::string, 4>> FourNumbers(std::string_view text) {
    std::array<std::string, 4> values;
    std::size_t count = 0;
    for (std::size_t start = 0;; ++count) {
        const std::size_t comma = text.find(',', start);
        const std::string_view item =
            text.substr(start, comma == std::string_view::npos ? comma : comma - start);
        double value = 0.0;
        if (count == values.size() || !ParseDouble(item, value) || !std::isfinite(value)) return std::nullopt;
        values[count] = std::string(Trimmed(item));
        if (comma == std::string_view::npos) break;
        start = comma + 1;
    }
    if (count + 1 != values.size()) return std::nullopt;
    return values;
}

} // namespace

void CChangeRepDriver::DeclareOptions(ui::DialogOptions& options) {
    for (std::size_t frame = 0; frame < m_frames.size(); ++frame) {
        const std::string name = "repere" + std::to_string(frame + 1);
        options.Value(name, "XA,YA,XB,YB", frame == 0 ? rep::kHelpFrame1 : rep::kHelpFrame2,
                      [this, frame, name](const std::string& text) {
                          m_frames[frame] = FourNumbers(text);
                          return m_frames[frame] ? std::string()
                                                 : Sprintf(rep::kBadFrame, name.c_str(), text.c_str());
                      });
    }
    const std::span<const ChangeRepSwitch> switches = ChangeRepSwitches();
    options.Value("selection", "SELECTION", rep::kHelpSelection, [this](const std::string& text) {
        m_selection = text;
        m_given[kSwitchAllPoints] = false;
        return std::string();
    });
    for (std::size_t i = 0; i < switches.size(); ++i)
        options.ZeroOrOne(switches[i].option, switches[i].help, [this, i](bool on) { m_given[i] = on; });
}

ui::DialogResult CChangeRepDriver::Run(ui::FrontEnd& frontEnd) {
    m_model.SetInputs(Inputs());
    if (GeoBaseNamed()) m_model.SetGeoBase(GeoBase());
    if (!m_model.Carnet()) return ui::DialogResult::Failed;
    for (std::size_t i = 0; i < m_given.size(); ++i)
        if (m_given[i]) m_model.GiveSwitch(i, *m_given[i]);
    m_model.OnInitDialog();
    for (std::size_t frame = 0; frame < m_frames.size(); ++frame)
        if (m_frames[frame])
            for (std::size_t i = 0; i < 4; ++i)
                m_model.SetField(static_cast<int>(frame * 4 + i), (*m_frames[frame])[i]);
    if (m_selection) m_model.SetSelection(*m_selection);
    if (!m_model.CanOK()) {
        frontEnd.MessageBox(rep::kFramesIncomplete, ui::kCaption, ui::kIconWarning);
        return ui::DialogResult::Failed;
    }
    return m_model.OnOK(frontEnd) ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

std::unique_ptr<ui::Form> CChangeRepDriver::MakeForm() {
    return std::make_unique<CChangeRepForm>(*this, m_model);
}

} // namespace pyr
