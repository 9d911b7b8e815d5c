#include "calc/ComputationDriver.h"

#include "core/Numbers.h"
#include "core/Undefined.h"

namespace pyr {

void CComputationDriver::DeclareOptions(ui::DialogOptions& options) {
    DeclareOwnOptions(options);
    DeclareSwitchOptions(options, m_requests);
    DeclareComputationOptions(options, m_requests, m_saveHelp);
}

ui::DialogResult CComputationDriver::Run(ui::FrontEnd& frontEnd) {
    m_computation.SetInputs(Inputs());
    if (GeoBaseNamed()) m_computation.SetGeoBase(GeoBase());
    if (!m_computation.Open(frontEnd))
        return m_computation.Cancelled() ? ui::DialogResult::Cancel : ui::DialogResult::Failed;
    if (m_requests.plani) m_computation.SetPlani(*m_requests.plani);
    if (m_requests.alti) m_computation.SetAlti(*m_requests.alti);
    bool ok = Compute(frontEnd);
    if (m_requests.save && m_computation.Modified() && !m_computation.Save()) ok = false;
    m_computation.Close(m_requests.listing, m_requests.listingPath);
    return ok ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

std::string Dashed(const std::string& text) {
    return text.empty() ? std::string("-") : text;
}

std::string DashedMetres(double metres) {
    return IsKnown(metres) ? FormatFixedShown(metres, 4) : std::string("-");
}

} // namespace pyr
