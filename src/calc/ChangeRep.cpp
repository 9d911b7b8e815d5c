#include "calc/ChangeRep.h"

#include "calc/ChangeRepTexts.h"
#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "settings/CalcOptions.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"

#include <cmath>

namespace pyr {

namespace {

constexpr ChangeRepSwitch kSwitches[] = {
    {"Change_repere", &ChangeRepOptions::changeFrame, true, rep::kBoxChangeFrame, "transformer-points",
     rep::kHelpChangeFrame},
    {"Modif_V0", &ChangeRepOptions::modifyV0, false, rep::kBoxModifyV0, "modif-v0", rep::kHelpModifyV0},
    {"TousLesPoints", &ChangeRepOptions::allPoints, true, rep::kBoxAllPoints, "tous-les-points",
     rep::kHelpAllPoints},
    {"PointsFixes", &ChangeRepOptions::fixedPoints, false, rep::kBoxFixedPoints, "points-fixes",
     rep::kHelpFixedPoints},
    {"Projection", &ChangeRepOptions::projection, false, rep::kBoxProjection, "projection",
     rep::kHelpProjection},
    {"Inverser_YZ", &ChangeRepOptions::swapYZ, false, rep::kBoxSwapYZ, "inverser-yz", rep::kHelpSwapYZ},
    {"Conserver_Z", &ChangeRepOptions::keepZ, false, rep::kBoxKeepZ, "conserver-z", rep::kHelpKeepZ},
};
static_assert(std::size(kSwitches) == kChangeRepSwitchCount);
static_assert(&ChangeRepOptions::allPoints == kSwitches[kSwitchAllPoints].member);

// A line shorter than a millimetre (its length squared in m²) has no direction to project onto.
constexpr double kShortestLineSquared = 1e-6;

double Distance(const CommonPoints& p) {
    return std::hypot(p.xb - p.xa, p.yb - p.ya);
}

} // namespace

// ---------------------------------------------------------------- the formulas

FrameChange FrameChangeFrom(const CommonPoints& frame1, const CommonPoints& frame2) {
    FrameChange change;
    const double g1 = Bearing(frame1.xa, frame1.ya, frame1.xb, frame1.yb);
    const double g2 = Bearing(frame2.xa, frame2.ya, frame2.xb, frame2.yb);
    change.rotation = WrapGrads(g1 - g2);
    // Reduced exactly: a rotation of 100 gr has a cosine of exactly 0.
    change.cosRotation = CosGrads(change.rotation);
    change.sinRotation = SinGrads(change.rotation);
    const double c = change.cosRotation, s = change.sinRotation;
    change.translationX = frame1.xa - c * frame2.xa - s * frame2.ya;
    change.translationY = frame1.ya + s * frame2.xa - c * frame2.ya;
    return change;
}

void IntoFrame2(const FrameChange& change, double& x, double& y) {
    const double dx = x - change.translationX, dy = y - change.translationY;
    x = dx * change.cosRotation - dy * change.sinRotation;
    y = dy * change.cosRotation + dx * change.sinRotation;
}

bool ProjectOntoLine(const CommonPoints& line, double& x, double& y) {
    const double ux = line.xb - line.xa, uy = line.yb - line.ya;
    const double squared = ux * ux + uy * uy;
    if (squared < kShortestLineSquared) return false;
    const double t = ((x - line.xa) * ux + (y - line.ya) * uy) / squared;
    x = line.xa + t * ux;
    y = line.ya + t * uy;
    return true;
}

double TurnedV0(double v0, double rotation) {
    return WrapGrads(v0 - rotation);
}

std::span<const ChangeRepSwitch> ChangeRepSwitches() {
    return kSwitches;
}

// ---------------------------------------------------------------- the dialog

std::string CChange_Rep::Caption() const {
    return rep::kCaption;
}

void CChange_Rep::OnInitDialog() {
    const std::string_view path = Inputs().paramPath;
    for (std::size_t i = 0; i < std::size(kSwitches); ++i) {
        const ChangeRepSwitch& entry = kSwitches[i];
        int value = entry.byDefault ? 1 : 0;
        ReadParamInt(path, kSectionChangeRep, entry.key, value, 0, 1, value);
        m_options.*entry.member = m_given[i].value_or(value != 0);
    }
    ApplyStoreOptions(path); // the decimals the coordinates are written to
    m_points = m_stations = 0;
    Notify(kPartSwitches);
}

void CChange_Rep::GiveSwitch(std::size_t which, bool on) {
    m_given.at(which) = on;
    m_options.*kSwitches[which].member = on;
    Notify(kPartSwitches);
}

bool CChange_Rep::Switch(std::size_t which) const {
    return which < std::size(kSwitches) && m_options.*kSwitches[which].member;
}

void CChange_Rep::SaveOptions() const {
    for (const ChangeRepSwitch& entry : kSwitches)
        WriteParamInt(Inputs().paramPath, kSectionChangeRep, entry.key, m_options.*entry.member ? 1 : 0);
}

bool CChange_Rep::SetField(int which, std::string_view text) {
    const auto at = static_cast<std::size_t>(which);
    m_texts.at(at) = std::string(text);
    double value = kUndefined;
    const bool empty = Trimmed(text).empty();
    const bool read = empty || (ParseDouble(text, value) && std::isfinite(value));
    m_values[at] = read && !empty ? value : kUndefined;
    Recompute();
    return read;
}

std::optional<CommonPoints> CChange_Rep::Frame(int frame) const {
    const std::size_t first = frame == 1 ? 0 : 4;
    for (std::size_t i = first; i < first + 4; ++i)
        if (!IsKnown(m_values[i])) return std::nullopt;
    return CommonPoints{m_values[first], m_values[first + 1], m_values[first + 2], m_values[first + 3]};
}

void CChange_Rep::Recompute() {
    const std::optional<CommonPoints> frame1 = Frame(1), frame2 = Frame(2);
    m_complete = frame1 && frame2;
    m_change = FrameChange{};
    if (m_complete) {
        const double d1 = Distance(*frame1), d2 = Distance(*frame2);
        m_status = Sprintf(rep::kDistances, d1, d2, std::fabs(d1 - d2));
        m_change = FrameChangeFrom(*frame1, *frame2);
        m_line = *frame1;
    } else if (frame1) {
        m_status = Sprintf(rep::kDistance1, Distance(*frame1));
    } else if (frame2) {
        m_status = Sprintf(rep::kDistance2, Distance(*frame2));
    } else {
        m_status.clear();
    }
    Notify(kPartFields);
}

std::string CChange_Rep::RotationText() const {
    return m_complete ? Sprintf(rep::kRotationFormat, m_change.rotation) : std::string();
}

std::string CChange_Rep::TranslationXText() const {
    return m_complete ? Sprintf(rep::kTranslationFormat, m_change.translationX) : std::string();
}

std::string CChange_Rep::TranslationYText() const {
    return m_complete ? Sprintf(rep::kTranslationFormat, m_change.translationY) : std::string();
}

void CChange_Rep::SetSelection(std::string text) {
    m_selection = std::move(text);
    Notify(kPartSelection);
}

// ---------------------------------------------------------------- OK

bool CChange_Rep::OnOK(ui::FrontEnd& frontEnd) {
    if (!m_complete) return false;
    SaveOptions();
    if (!Apply(frontEnd)) return false;
    if (Changed())
        frontEnd.MessageBox(Sprintf(rep::kDone, m_points, m_stations), ui::kCaption, ui::kIconInformation);
    else
        frontEnd.MessageBox(msg::kNoChange, ui::kCaption, ui::kIconInformation);
    return true;
}

bool CChange_Rep::Apply(ui::FrontEnd& frontEnd) {
    m_points = m_stations = 0;
    m_changes.clear();
    if (!m_complete || !m_carnet) return false;
    m_chosen.reset();
    if (!m_options.allPoints) {
        m_chosen = CSelection::Parse(m_selection);
        if (!m_chosen) {
            frontEnd.MessageBox(msg::kNoSelection, ui::kCaption, ui::kIconWarning);
            return false;
        }
    }
    const bool movesPoints = m_options.changeFrame || m_options.projection || m_options.swapYZ;
    const int size = m_carnet->GetSize();
    m_changes.reserve(static_cast<std::size_t>(size));
    for (int i = 0; i < size; ++i) {
        const int kind = m_carnet->GetType(i);
        if (kind == kKindPoint && movesPoints && MovePoint(i))
            ++m_points;
        else if (kind == kKindStation && m_options.modifyV0 && TurnStation(i))
            ++m_stations;
    }
    m_chosen.reset();
    if (Changed()) Notify(kPartGeoBase);
    return true;
}

bool CChange_Rep::MovePoint(int index) {
    const auto& point = static_cast<const CPointGen&>(*m_carnet->GetAt(index));
    if (!point.hasXY()) return false;
    const bool zRewritten = m_options.swapYZ && !m_options.keepZ;
    if (!m_options.fixedPoints && (point.invariantXY() || (zRewritten && point.invariantZ()))) return false;
    // The altitude drawn as Y: a point without one would lose its place in the plan.
    if (m_options.swapYZ && !point.hasZ()) return false;
    if (!Selected(point.mat())) return false;

    double x = point.x(), y = point.y();
    if (m_options.projection && !ProjectOntoLine(m_line, x, y)) return false;
    if (m_options.changeFrame) IntoFrame2(m_change, x, y);
    if (!std::isfinite(x) || !std::isfinite(y)) return false;

    // The state before kept for the undo, then the point rewritten where it stands.
    ElementChange change{index, m_carnet->copyElement(index)};
    auto& written = static_cast<CPointGen&>(*m_carnet->GetAt(index));
    if (!written.setPt(x, m_options.swapYZ ? written.z() : y)) return false;
    // Y' goes into Z with the planimetry's decimals: swapped back, the point comes back whole.
    if (m_options.swapYZ && !m_options.keepZ) written.setZ(RoundToDecimals(y, CPointGen::DeciXY()));
    m_changes.push_back(std::move(change));
    return true;
}

bool CChange_Rep::TurnStation(int index) {
    auto& station = static_cast<CStation&>(*m_carnet->GetAt(index));
    if (station.v0() < 0.0 || !Selected(station.mat())) return false;
    // Rounded, then wrapped again: 399.999999 gr kept to 5 decimals is 0.
    const double v0 =
        WrapGrads(RoundToDecimals(TurnedV0(station.v0(), m_change.rotation), CStation::DeciAng()));
    if (!std::isfinite(v0)) return false;
    m_changes.push_back({index, m_carnet->copyElement(index)});
    station.setV0(v0);
    return true;
}

bool ElementChange::Exchange(CCarnet& carnet) {
    return carnet.ExchangeAt(index, other);
}

} // namespace pyr
