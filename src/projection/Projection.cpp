#include "projection/Projection.h"

#include "core/Strings.h"

namespace pyr {

struct CProjection::Impl {};

CProjection::CProjection(std::string_view name, double earthRadiusKm)
    : m_name(Trimmed(name)), m_earthRadiusKm(earthRadiusKm) {
    if (!IsNone()) m_error = Sprintf("Projection <%s> inconnue !", m_name.c_str());
}

CProjection::~CProjection() = default;
CProjection::CProjection(CProjection&&) noexcept = default;
CProjection& CProjection::operator=(CProjection&&) noexcept = default;

bool CProjection::IsNone() const {
    return m_name.empty() || EqualIgnoringCase(m_name, "Aucune");
}

double CProjection::CalcLinearAlter(double, double) const {
    return 0.0;
}

double CProjection::CalcEllipsReduc(double, double, double z, int direction) const {
    const double r = m_earthRadiusKm * 1000.0;
    return direction >= 0 ? -z / (r + z) * 1e6 : z / r * 1e6;
}

bool CProjection::Convert(const CProjection&, double&, double&) const {
    return false;
}

} // namespace pyr
