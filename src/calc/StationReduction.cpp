#include "calc/StationReduction.h"

#include "calc/Corrections.h"
#include "calc/SightingReduction.h"
#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "settings/CalcOptions.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"

#include <algorithm>
#include <cmath>
#include <unordered_set>

namespace pyr {

namespace {

constexpr const char* kGroupStations = "Réduction des stations";
constexpr const char* kGroupObservations = "Réduction des observations";
constexpr const char* kGroupEccentrics = "Réduction des excentres et appareils";

constexpr ReductionSwitch kSwitches[] = {
    {"VisComm", &ReductionOptions::visComm, true, "Réduire les reprises à partir des visées &communes",
     kGroupStations},
    {"V0BasedOn", &ReductionOptions::v0BasedOn, false, "Réduire les reprises à partir du &V0 (si connu)",
     kGroupStations},
    {"OtherSight", &ReductionOptions::otherSight, false,
     "Réduire les reprises non &orientées (V0 considéré identique) ", kGroupStations},
    {"Suppress", &ReductionOptions::suppress, false, "&Supprimer les anciennes stations", kGroupStations},
    {"DoMeans", &ReductionOptions::doMeans, false, "Faire la &moyenne des mesures reprises par station",
     kGroupObservations},
    {"InExcent", &ReductionOptions::inExcent, false, "Intégrer les &excentrements dans les observations",
     kGroupEccentrics},
    {"InAppareil", &ReductionOptions::inAppareil, false,
     "Intégrer les corrections d'&appareils dans les observations", kGroupEccentrics},
};
static_assert(std::size(kSwitches) == kReductionSwitchCount);

// A value computed anew is kept to the decimals of the store's settings; one left as it was stays as read.
double Kept(double value, double old, int decimals) {
    return value == old ? old : RoundToDecimals(value, decimals);
}

} // namespace

std::span<const ReductionSwitch> ReductionSwitches() {
    return kSwitches;
}

// ---------------------------------------------------------------- the dialog

void CReduction_Station::OnInitDialog() {
    const std::string_view path = Inputs().paramPath;
    for (std::size_t i = 0; i < std::size(kSwitches); ++i) {
        const ReductionSwitch& entry = kSwitches[i];
        int value = entry.byDefault ? 1 : 0;
        ReadParamInt(path, kSectionReduction, entry.key, value, 0, 1, value);
        m_options.*entry.member = m_given[i].value_or(value != 0);
    }
    ApplyStoreOptions(path); // the decimals the values computed are kept to
    m_foldVertical = ReadOptionSwitch(path, kSectionCalculations, kKeyFoldVertical);
    m_defaultInstrument = DefaultInstrument(path);
    m_changed = false;
    Notify(kPartSwitches);
}

void CReduction_Station::GiveSwitch(std::size_t which, bool on) {
    m_given.at(which) = on;
    m_options.*kSwitches[which].member = on;
    Notify(kPartSwitches);
}

bool CReduction_Station::Switch(std::size_t which) const {
    return which < std::size(kSwitches) && m_options.*kSwitches[which].member;
}

void CReduction_Station::SaveOptions() const {
    for (const ReductionSwitch& entry : kSwitches)
        WriteParamInt(Inputs().paramPath, kSectionReduction, entry.key, m_options.*entry.member ? 1 : 0);
}

void CReduction_Station::OnOK(ui::FrontEnd& frontEnd) {
    SaveOptions();
    Reduce(frontEnd);
}

// ---------------------------------------------------------------- the reduction

void CReduction_Station::Reduce(ui::FrontEnd& frontEnd) {
    frontEnd.MessageBox(kReductionWarning, ui::kCaption, ui::kIconWarning);
    if (!m_carnet) return;
    m_reducing = true;
    m_merged = -1;
    if (m_options.inAppareil) IntegrateInstrumentCorrections();

    std::vector<std::string> names;
    std::unordered_set<std::string> seen;
    for (int i = m_carnet->Find(kKindStation, "", 0); i >= 0; i = m_carnet->Find(kKindStation, "", i + 1)) {
        std::string name = m_carnet->matAt(i);
        if (seen.insert(name).second) names.push_back(std::move(name));
    }
    for (const std::string& name : names)
        MergeReprises(name);

    m_reducing = false;
    Settle();
    Notify(kPartGeoBase);
}

void CReduction_Station::MergeReprises(const std::string& name) {
    BuildRepriseBlocks(name);
    if (m_blocks.empty()) return;
    // Each set-up on its own first, from the last: what is deleted in one leaves the others in place.
    for (auto block = m_blocks.rbegin(); block != m_blocks.rend(); ++block) {
        if (m_options.inExcent) IntegrateEccentricities(*block);
        if (m_options.doMeans) MeanRepeatedSightings(*block);
    }
    if (m_blocks.size() == 1) return;
    BuildRepriseBlocks(name);

    const int count = static_cast<int>(m_blocks.size());
    for (int a = 0; a < count; ++a) {
        if (m_options.visComm)
            for (int b = a + 1; b < count; ++b)
                CommonSightOffset(m_blocks, a, b);
        if (m_options.v0BasedOn) V0Offsets(m_blocks, a);
    }

    // The first set-up linked to others becomes the merged station; the others come in its orientation
    // and at its instrument height.
    int merged = -1;
    double reference = kUndefined;
    for (int a = 0; a < count; ++a) {
        if (m_blocks[a].links.empty()) continue;
        if (merged < 0) {
            reference = StationHeight(m_blocks[a]);
            AppendReprise(true, 0.0, 0.0, m_blocks[a]);
            merged = m_merged;
        }
        for (std::size_t k = 0; k < m_blocks[a].links.size(); ++k) {
            CRepriseBlock& other = m_blocks[m_blocks[a].links[k]];
            if (other.merged) continue;
            AppendReprise(false, m_blocks[a].offsets[k], HeightBelow(reference, other), other);
        }
    }
    if (merged >= 0 && IsKnown(reference)) SetStationHeight(merged, reference);

    if (m_options.otherSight)
        for (CRepriseBlock& block : m_blocks) {
            if (block.merged) continue;
            if (merged < 0) {
                reference = StationHeight(block);
                AppendReprise(true, 0.0, 0.0, block);
                merged = m_merged;
                continue;
            }
            AppendReprise(false, 0.0, HeightBelow(reference, block), block);
        }

    if (m_options.suppress)
        for (auto block = m_blocks.rbegin(); block != m_blocks.rend(); ++block)
            if (block->merged) RemoveRange(block->startIndex, block->endIndex);

    m_merged = merged;
    if (merged >= 0 && m_options.doMeans) {
        CRepriseBlock whole;
        whole.name = name;
        whole.stationIndex = whole.startIndex = merged;
        whole.endIndex = m_carnet->GetSize();
        whole.repriseNumber = 1;
        whole.V0 = m_carnet->v0At(merged);
        MeanRepeatedSightings(whole);
    }
}

void CReduction_Station::IntegrateInstrumentCorrections() {
    if (!m_carnet) return;
    for (int station = NextStation(0); station >= 0;) {
        const int next = NextStation(station + 1);
        const InstrumentConstants constants = InstrumentConstantsAt(*m_carnet, station, m_defaultInstrument);
        const int end = next < 0 ? m_carnet->GetSize() : next;
        for (int i = station + 1; i < end; ++i) {
            if (!IsSightingAt(i)) continue;
            CVisee& sighting = SightingAt(i);
            double av = sighting.av(), di = sighting.di();
            ApplyInstrumentConstants(av, di, constants);
            StoreSighting(sighting, sighting.ah(), av, di, sighting.hp());
        }
        station = next;
    }
    for (int i = m_carnet->Find(kKindAppareil, "", 0); i >= 0; i = m_carnet->Find(kKindAppareil, "", i + 1))
        if (!IsRemoved(i)) Remove(i);
    EndStep();
}

void CReduction_Station::IntegrateEccentricities(CRepriseBlock& block) {
    if (!m_carnet) return;
    const double ev = OffsetsAt(block.stationIndex, block.startIndex - 1).vertical;
    const double hi = m_carnet->hiAt(block.stationIndex);
    if (ev != 0.0 && IsKnown(hi)) SetStationHeight(block.stationIndex, hi + ev);
    for (int i = block.stationIndex + 1; i < block.endIndex; ++i)
        if (IsSightingAt(i)) ReduceSighting(i, block.stationIndex - 1, true);
    for (int i = block.startIndex; i < block.endIndex; ++i)
        if (!IsRemoved(i) && KindAt(i) == kKindExcentrement) Remove(i);
    EndStep(&block);
}

void CReduction_Station::MeanRepeatedSightings(CRepriseBlock& block) {
    if (!m_carnet) return;
    const int limit = block.stationIndex - 1;
    for (int i = block.stationIndex + 1; i < block.endIndex; ++i) {
        if (!IsSightingAt(i)) continue;
        TurnToFaceLeft(i);
        const std::string mat = m_carnet->matAt(i);
        int repetition = NextRepetition(mat, i + 1, block.endIndex);
        if (repetition < 0) continue;

        ReduceSighting(i, limit, true);
        RemoveEccentricsBefore(i);
        CVisee& first = SightingAt(i);
        CRepetitionMean mean(first);
        std::string code = first.sym();
        bool reference = KindAt(i) == kKindReference;
        for (; repetition >= 0; repetition = NextRepetition(mat, repetition + 1, block.endIndex)) {
            if (code.empty()) code = m_carnet->symAt(repetition);
            if (KindAt(repetition) == kKindReference) reference = true;
            // A repetition is taken as it stands, on whatever face it was read.
            ReduceSighting(repetition, limit, false);
            RemoveEccentricsBefore(repetition);
            mean.Add(SightingAt(repetition));
            Remove(repetition);
        }
        CMesure result(first);
        mean.WriteInto(result);
        StoreSighting(first, result.ah(), result.av(), result.di(), result.hp());
        first.setSym(code);
        if (reference) SetKind(i, kKindReference);
        m_changed = true;
    }
    EndStep(&block);
}

void CReduction_Station::BuildRepriseBlocks(const std::string& name) {
    m_blocks.clear();
    if (!m_carnet) return;
    int reprise = 0;
    for (int i = m_carnet->Find(kKindStation, name, 0); i >= 0;
         i = m_carnet->Find(kKindStation, name, i + 1)) {
        if (IsRemoved(i) || m_carnet->matAt(i) != name) continue;
        CRepriseBlock block;
        block.owner = &m_blocks;
        block.name = name;
        block.stationIndex = i;
        block.repriseNumber = ++reprise;
        block.V0 = m_carnet->v0At(i);
        block.startIndex = i;
        while (block.startIndex > 0 &&
               (IsRemoved(block.startIndex - 1) || !IsObservationOrPointKind(KindAt(block.startIndex - 1))))
            --block.startIndex;
        const int next = NextStation(i + 1);
        block.endIndex = next < 0 ? m_carnet->GetSize() : next;
        if (next >= 0)
            while (block.endIndex > i + 1 && !IsSightingAt(block.endIndex - 1))
                --block.endIndex;
        m_blocks.push_back(std::move(block));
    }
}

void CReduction_Station::CommonSightOffset(CRepriseList& blocks, int a, int b) {
    if (!m_carnet) return;
    CRepriseBlock& first = blocks[static_cast<std::size_t>(a)];
    const CRepriseBlock& second = blocks[static_cast<std::size_t>(b)];
    std::vector<std::pair<double, double>> pairs;
    std::vector<int> matches;
    for (int i = first.endIndex - 1; i > first.stationIndex; --i) {
        if (!IsSightingAt(i)) continue;
        const std::string mat = m_carnet->matAt(i);
        matches.clear();
        for (int j = NextRepetition(mat, second.stationIndex + 1, second.endIndex); j >= 0;
             j = NextRepetition(mat, j + 1, second.endIndex))
            matches.push_back(j);
        for (auto j = matches.rbegin(); j != matches.rend(); ++j) {
            ReduceSighting(i, first.stationIndex - 1, true);
            RemoveEccentricsBefore(i);
            ReduceSighting(*j, second.stationIndex - 1, true);
            RemoveEccentricsBefore(*j);
            const double ahA = m_carnet->ahAt(i), ahB = m_carnet->ahAt(*j);
            if (IsKnown(ahA) && IsKnown(ahB)) pairs.emplace_back(ahA, ahB);
        }
    }
    if (!pairs.empty()) first.AddLink(second.repriseNumber, MeanOrientationOffset(pairs));
    EndStep(&first, &blocks);
}

void CReduction_Station::V0Offsets(CRepriseList& blocks, int a) {
    CRepriseBlock& first = blocks[static_cast<std::size_t>(a)];
    if (!first.HasV0()) return;
    for (int b = 0; b < static_cast<int>(blocks.size()); ++b) {
        const CRepriseBlock& other = blocks[static_cast<std::size_t>(b)];
        if (b != a && other.HasV0()) first.AddLink(other.repriseNumber, V0Offset(first.V0, other.V0));
    }
}

void CReduction_Station::AppendReprise(bool withStation, double angle, double dh, CRepriseBlock& block) {
    if (!m_carnet) return;
    block.merged = 1;
    if (withStation) m_merged = -1;
    const int end = block.endIndex;
    for (int i = withStation ? block.stationIndex : block.stationIndex + 1; i < end; ++i) {
        const int kind = KindAt(i);
        if (IsRemoved(i) || (kind == kKindPoint && !m_options.suppress)) continue;
        const int copy = m_carnet->Add(m_carnet->copyElement(i, kind), kind);
        if (copy < 0) continue;
        m_changed = true;
        if (i == block.stationIndex) m_merged = copy;
        if (!IsSightingKind(kind)) continue;
        CVisee& sighting = SightingAt(copy);
        // The direction is turned even when it is unknown, as the merged set-ups always were.
        const double ah = std::fmod(sighting.ah() + angle, 400.0);
        double av = sighting.av(), di = sighting.di(), hp = sighting.hp();
        if (IsKnown(hp) && m_foldVertical && IsKnown(av) && di > 0.0) {
            // The line of sight seen from dh higher: the same horizontal length, dh less to climb.
            const double h = di * SinGrads(av), v = di * CosGrads(av);
            av = WrapGrads(ZenithRaised(h, v, -dh));
            di = std::hypot(h, v - dh);
        } else if (IsKnown(hp)) {
            hp += dh;
        }
        StoreSighting(sighting, ah, av, di, hp);
    }
    EndStep(&block);
}

// ---------------------------------------------------------------- sightings and their offsets

void CReduction_Station::StoreSighting(CVisee& sighting, double ah, double av, double di, double hp) {
    if (ah == sighting.ah() && av == sighting.av() && di == sighting.di() && hp == sighting.hp()) return;
    sighting.setAH(Kept(ah, sighting.ah(), CVisee::DeciAng()));
    sighting.setAV(Kept(av, sighting.av(), CVisee::DeciAng()));
    sighting.setDI(Kept(di, sighting.di(), CVisee::DeciXY()));
    sighting.setHP(Kept(hp, sighting.hp(), CVisee::DeciZ()));
    m_changed = true;
}

void CReduction_Station::TurnToFaceLeft(int index) {
    CVisee& sighting = SightingAt(index);
    double ah = sighting.ah(), av = sighting.av();
    if (ReduceToFaceLeft(ah, av)) StoreSighting(sighting, ah, av, sighting.di(), sighting.hp());
}

void CReduction_Station::ReduceSighting(int index, int limit, bool faceLeft) {
    CVisee& sighting = SightingAt(index);
    double ah = sighting.ah(), av = sighting.av(), di = sighting.di(), hp = sighting.hp();
    if (faceLeft) ReduceToFaceLeft(ah, av);
    const Offsets offsets = OffsetsAt(index, limit);
    ReduceEccentricSighting(ah, av, di, hp, offsets.radial, offsets.tangential, offsets.vertical,
                            m_foldVertical);
    StoreSighting(sighting, ah, av, di, hp);
}

// The offsets written in front of the element, nearest first, back to `limit` (excluded) and never
// beyond the preceding observation or point; what the reduction deleted is not there any more.
CReduction_Station::Offsets CReduction_Station::OffsetsAt(int index, int limit) const {
    Offsets offsets;
    bool radial = false, tangential = false, vertical = false;
    for (int i = index - 1; i > limit && i >= 0; --i) {
        if (IsRemoved(i)) continue;
        const int kind = KindAt(i);
        if (IsObservationOrPointKind(kind)) break;
        if (kind != kKindExcentrement) continue;
        const auto& command = static_cast<const CCommande&>(*m_carnet->GetAt(i));
        if (!radial && EqualIgnoringCase(command.word(), kExcentRad))
            offsets.radial = command.value(), radial = true;
        else if (!tangential && EqualIgnoringCase(command.word(), kExcentTan))
            offsets.tangential = command.value(), tangential = true;
        else if (!vertical && EqualIgnoringCase(command.word(), kExcentVer))
            offsets.vertical = command.value(), vertical = true;
    }
    return offsets;
}

void CReduction_Station::RemoveEccentricsBefore(int index) {
    for (int i = index - 1; i >= 0; --i) {
        if (IsRemoved(i)) continue;
        const int kind = KindAt(i);
        if (IsObservationOrPointKind(kind)) break;
        if (kind == kKindExcentrement) Remove(i);
    }
}

// The height of a set-up's instrument above its station point: HI and the station's vertical offset.
double CReduction_Station::StationHeight(const CRepriseBlock& block) const {
    const double hi = m_carnet->hiAt(block.stationIndex);
    if (!IsKnown(hi)) return kUndefined;
    return hi + OffsetsAt(block.stationIndex, block.startIndex - 1).vertical;
}

double CReduction_Station::HeightBelow(double reference, const CRepriseBlock& block) const {
    const double height = StationHeight(block);
    return IsKnown(reference) && IsKnown(height) ? reference - height : 0.0;
}

void CReduction_Station::SetStationHeight(int index, double hi) {
    auto* station = m_carnet->As<CStation>(index);
    if (!station || station->hi() == hi) return;
    station->setHI(Kept(hi, station->hi(), CStation::DeciZ()));
    m_changed = true;
}

// ---------------------------------------------------------------- deletions kept until settled

bool CReduction_Station::IsRemoved(int index) const {
    return index >= 0 && static_cast<std::size_t>(index) < m_removed.size() && m_removed[index];
}

int CReduction_Station::KindAt(int index) const {
    if (m_kindChanged && index >= 0 && static_cast<std::size_t>(index) < m_kinds.size() && m_kinds[index])
        return m_kinds[index];
    return m_carnet->GetType(index);
}

bool CReduction_Station::IsSightingAt(int index) const {
    return !IsRemoved(index) && IsSightingKind(KindAt(index));
}

CVisee& CReduction_Station::SightingAt(int index) {
    return static_cast<CVisee&>(*m_carnet->GetAt(index));
}

void CReduction_Station::Remove(int index) {
    if (IsRemoved(index) || !m_carnet->IsValidIndex(index)) return;
    if (m_removed.size() < static_cast<std::size_t>(m_carnet->GetSize()))
        m_removed.resize(static_cast<std::size_t>(m_carnet->GetSize()), 0);
    m_removed[index] = 1;
    ++m_removedCount;
    m_changed = true;
}

void CReduction_Station::RemoveRange(int first, int last) {
    for (int i = first; i < last; ++i)
        Remove(i);
}

void CReduction_Station::SetKind(int index, int kind) {
    if (KindAt(index) == kind) return;
    if (m_kinds.size() < static_cast<std::size_t>(m_carnet->GetSize()))
        m_kinds.resize(static_cast<std::size_t>(m_carnet->GetSize()), 0);
    m_kinds[index] = kind;
    m_kindChanged = true;
    m_changed = true;
}

int CReduction_Station::NextStation(int from) const {
    int i = m_carnet->Find(kKindStation, "", from);
    while (i >= 0 && IsRemoved(i))
        i = m_carnet->Find(kKindStation, "", i + 1);
    return i;
}

// The next sighting of that point in [from, end), through the store's index of identifiers.
int CReduction_Station::NextRepetition(const std::string& mat, int from, int end) const {
    if (mat.empty()) {
        for (int i = from; i < end; ++i)
            if (IsSightingAt(i) && m_carnet->matAt(i).empty()) return i;
        return -1;
    }
    for (int i = m_carnet->Find(0, mat, from); i >= 0 && i < end; i = m_carnet->Find(0, mat, i + 1))
        if (IsSightingAt(i)) return i;
    return -1;
}

void CReduction_Station::EndStep(CRepriseBlock* block, CRepriseList* list) {
    if (!m_reducing) Settle(block, list);
}

void CReduction_Station::Settle(CRepriseBlock* block, CRepriseList* list) {
    if (!m_carnet || (m_removedCount == 0 && !m_kindChanged)) return;
    const int size = m_carnet->GetSize();
    if (m_removedCount == 0) {
        for (int i = 0; i < static_cast<int>(m_kinds.size()); ++i)
            if (m_kinds[i]) m_carnet->SetKindAt(i, m_kinds[i]);
    } else {
        // before[i]: how many elements are kept before index i, the new index of a kept element.
        std::vector<int> before(static_cast<std::size_t>(size) + 1, 0);
        CCarnet kept;
        for (int i = 0; i < size; ++i) {
            before[i + 1] = before[i] + (IsRemoved(i) ? 0 : 1);
            if (IsRemoved(i)) continue;
            const int kind = KindAt(i);
            kept.Add(m_carnet->copyElement(i, kind), kind);
        }
        m_carnet->RemoveAll();
        m_carnet->Append(std::move(kept));

        auto shift = [&](CRepriseBlock& b) {
            const bool gone = IsRemoved(b.stationIndex);
            b.stationIndex = gone ? -1 : before[std::clamp(b.stationIndex, 0, size)];
            b.startIndex = before[std::clamp(b.startIndex, 0, size)];
            b.endIndex = before[std::clamp(b.endIndex, 0, size)];
        };
        std::vector<CRepriseList*> lists{&m_blocks};
        for (CRepriseList* other : {list, block ? block->owner : nullptr})
            if (other && std::find(lists.begin(), lists.end(), other) == lists.end()) lists.push_back(other);
        bool blockShifted = block == nullptr;
        for (CRepriseList* other : lists)
            for (CRepriseBlock& b : *other) {
                shift(b);
                blockShifted = blockShifted || &b == block;
            }
        if (!blockShifted) shift(*block);
        if (m_merged >= 0) m_merged = IsRemoved(m_merged) ? -1 : before[std::min(m_merged, size)];
    }
    m_removed.clear();
    m_removedCount = 0;
    m_kinds.clear();
    m_kindChanged = false;
}

} // namespace pyr
