#include "geobase/Elements.h"

#include "core/Angles.h"
#include "core/Numbers.h"
#include "geobase/Carnet.h"
#include "geobase/Kinds.h"

#include <cmath>

namespace pyr {

void CElement::setMat(std::string mat) {
    // The store's index views the identifier in place: an unchanged identifier keeps its buffer.
    if (mat == m_mat) return;
    if (m_inStore) ++s_identifierChanges;
    m_mat = std::move(mat);
}

const std::string& CElement::NoText() {
    static const std::string none;
    return none;
}

void CElement::setSym(std::string sym) {
    if (!m_more && sym.empty()) return;
    if (!m_more) m_more = std::make_unique<More>();
    m_more->sym = std::move(sym);
    if (m_more->sym.empty() && m_more->par.empty()) m_more.reset();
}

void CElement::setPar(std::string par) {
    if (!m_more && par.empty()) return;
    if (!m_more) m_more = std::make_unique<More>();
    m_more->par = std::move(par);
    if (m_more->sym.empty() && m_more->par.empty()) m_more.reset();
}

double CVisee::dh() const {
    if (IsUndefined(m_av) || IsUndefined(m_di)) return kUndefined;
    return m_di * SinGrads(m_av);
}

bool CPointGen::setPt(double x, double y, double z, bool invariant) {
    if (!std::isfinite(x) || !std::isfinite(y) || !std::isfinite(z)) return false;
    return setPt(x, y, invariant) && setPt(z, invariant);
}

bool CPointGen::setPt(double x, double y, bool invariant) {
    if (!std::isfinite(x) || !std::isfinite(y)) return false;
    m_x = RoundToDecimals(x, s_deciXY);
    m_y = RoundToDecimals(y, s_deciXY);
    if (invariant) m_invariantXY = true;
    return true;
}

bool CPointGen::setPt(double z, bool invariant) {
    if (!std::isfinite(z)) return false;
    m_z = RoundToDecimals(z, s_deciZ);
    if (invariant) m_invariantZ = true;
    return true;
}

bool CChemin::add(int index, const CCarnet& store) {
    if (store.GetType(index) != kKindStation) return false;
    add(store.StationDesignation(index));
    return true;
}

double CCommande::value() const {
    // The parameters may start with blanks or a label-free number: "0.150", " -0.05 m".
    return LenientAtof(par());
}

bool ElementFitsKind(const CElement& element, int kind) {
    switch (kind) {
    case kKindComment:
        return dynamic_cast<const CComment*>(&element) != nullptr;
    case kKindStation:
        return dynamic_cast<const CStation*>(&element) != nullptr;
    case kKindReference:
        return dynamic_cast<const CReference*>(&element) != nullptr;
    case kKindMesure:
        return dynamic_cast<const CMesure*>(&element) != nullptr;
    case kKindLectAR:
        return dynamic_cast<const CLectAR*>(&element) != nullptr;
    case kKindLectAV:
        return dynamic_cast<const CLectAV*>(&element) != nullptr;
    case kKindPoint:
        return dynamic_cast<const CPointGen*>(&element) != nullptr;
    case kKindChemin:
        return dynamic_cast<const CChemin*>(&element) != nullptr;
    case kKindAppareil:
        return dynamic_cast<const CAppareil*>(&element) != nullptr;
    default:
        return IsCommandKind(kind) && dynamic_cast<const CCommande*>(&element) != nullptr;
    }
}

void SetStoreDecimals(int deciXY, int deciZ, int deciAng) {
    CCarnet::setDeciXY(deciXY);
    CCarnet::setDeciZ(deciZ);
    CCarnet::setDeciAng(deciAng);
    CPointGen::setDeciXY(deciXY);
    CPointGen::setDeciZ(deciZ);
    CStation::setDeciZ(deciZ);
    CStation::setDeciAng(deciAng);
    CReference::setDeciXY(deciXY);
    CReference::setDeciZ(deciZ);
    CReference::setDeciAng(deciAng);
    CAppareil::setDeciXY(deciXY);
    CAppareil::setDeciAng(deciAng);
    CLectAR::setDeciXY(deciXY);
    CLectAR::setDeciZ(deciZ);
}

} // namespace pyr
