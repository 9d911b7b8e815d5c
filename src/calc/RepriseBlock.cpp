#include "calc/RepriseBlock.h"

#include "core/Angles.h"
#include "geobase/Elements.h"

#include <cmath>

namespace pyr {

double MeanOrientationOffset(const std::vector<std::pair<double, double>>& pairs) {
    if (pairs.empty()) return kUndefined;
    const double first = pairs.front().first - pairs.front().second;
    double sum = 0.0;
    for (const auto& [ahA, ahB] : pairs) {
        double delta = ahA - ahB;
        if (delta - first > 200.0) delta -= 400.0;
        if (delta - first < -200.0) delta += 400.0;
        sum += delta;
    }
    return WrapGrads(sum / static_cast<double>(pairs.size()));
}

double V0Offset(double v0A, double v0B) {
    return WrapGrads(v0B - v0A);
}

double BringNearMean(double ah, double mean) {
    const double gap = std::fabs(mean - ah);
    if (gap > 150.0 && gap < 250.0) return ah <= mean ? ah + 200.0 : ah - 200.0;
    if (gap > 300.0) return ah <= mean ? ah + 400.0 : ah - 400.0;
    return ah;
}

double ZenithRaised(double h, double v, double rise) {
    return RadiansToGrads(std::atan2(h, v + rise));
}

CRepetitionMean::CRepetitionMean(const CVisee& first) {
    if (IsKnown(first.ah())) m_ahSum = first.ah(), m_ahCount = 1;
    m_avSum = first.av();
    m_avCount = IsKnown(first.av()) ? 1 : 0;
    m_hp = first.hp();
    if (first.di() > 0.0) {
        m_diSum = first.di(), m_diCount = 1;
        if (IsKnown(first.av())) m_hSum = first.di() * SinGrads(first.av()), m_hCount = 1;
    }
}

void CRepetitionMean::Add(const CVisee& repetition) {
    const double di = repetition.di(), av = repetition.av(), hp = repetition.hp();
    double h = kUndefined, v = kUndefined;
    if (di > 0.0) {
        m_diSum += di;
        ++m_diCount;
        if (IsKnown(av)) {
            h = di * SinGrads(av);
            v = di * CosGrads(av);
            m_hSum = m_hCount == 0 ? h : m_hSum + h;
            ++m_hCount;
        }
    }

    if (IsKnown(repetition.ah())) {
        if (m_ahCount == 0)
            m_ahSum = repetition.ah();
        else
            m_ahSum += BringNearMean(repetition.ah(), m_ahSum / m_ahCount);
        ++m_ahCount;
    }

    if (IsKnown(m_hp) && IsKnown(m_avSum)) {
        // The zenith angle the repetition would have had on the first sighting's target.
        if (IsKnown(h) && IsKnown(hp)) {
            m_avSum += ZenithRaised(h, v, m_hp - hp);
            ++m_avCount;
        }
    } else if (IsKnown(av) && IsKnown(hp)) {
        m_avSum = av;
        m_hp = hp;
        m_avCount = 1;
    }
}

void CRepetitionMean::WriteInto(CVisee& first) const {
    if (m_ahCount > 0) {
        first.setAH(WrapGrads(m_ahSum / m_ahCount));
    }
    if (m_avCount > 0) {
        first.setHP(m_hp);
        first.setAV(m_avSum / m_avCount);
    }
    const double av = first.av();
    if (m_hCount > 0) {
        const double sine = IsKnown(av) ? SinGrads(av) : 0.0;
        // A vertical line of sight has no horizontal length to carry its distance: the mean slope
        // distance stands for it.
        if (sine != 0.0)
            first.setDI(m_hSum / m_hCount / sine);
        else if (m_diCount > 0)
            first.setDI(m_diSum / m_diCount);
    } else if (m_diSum == 0.0 && m_avCount > 0) {
        first.setDI(0.0);
    }
}

} // namespace pyr
