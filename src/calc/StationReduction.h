#pragma once

#include "calc/RepriseBlock.h"
#include "settings/CalcOptions.h"
#include "settings/OptionInstruments.h"
#include "ui/DialogModel.h"

#include <array>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

// The reduction of the stations of a GéoBase, in place: the instrument corrections and the eccentric
// offsets folded into the sightings, the repeated sightings of a point from one station averaged, and
// the set-ups (reprises) of one station point merged into a single station with one orientation and one
// instrument height.
namespace pyr {

namespace ui {
class FrontEnd;
}

class CCarnet;
class CVisee;

inline constexpr const char* kReductionCaption = "Réduction des stations";
inline constexpr const char* kReductionWarning =
    "ATTENTION : Vérifier que la codification n'est pas altérée par cette commande !";
inline constexpr const char* kSectionReduction = "Reduction_des_Stations";
// The calculation options the reduction reads ("Options_Calculs").
inline constexpr const char* kKeyFoldVertical = "ExcentVertDansAngles";

// The seven switches of the dialog, kept in the section "Reduction_des_Stations".
inline constexpr std::size_t kReductionSwitchCount = 7;
struct ReductionOptions {
    bool visComm = true;     // offsets between set-ups from their common sightings
    bool v0BasedOn = false;  // offsets between set-ups from their known V0
    bool otherSight = false; // set-ups without any offset merged as they stand (same V0 taken)
    bool suppress = false;   // the merged set-ups deleted once copied
    bool doMeans = false;    // repeated sightings of a point from one station averaged
    bool inExcent = false;   // eccentric offsets folded into the sightings
    bool inAppareil = false; // instrument corrections folded into the sightings
};

// One switch: its key, its check box (the '&' marks the shortcut letter) and its group.
struct ReductionSwitch {
    const char* key;
    bool ReductionOptions::*member;
    bool byDefault;
    const char* checkBox;
    const char* group;
};
std::span<const ReductionSwitch> ReductionSwitches();

// The dialog "Réduction des stations", opened by the GéoBase editor on the GéoBase it holds: seven check
// boxes, kept in the parameter file, and OK, which reduces the stations of that GéoBase in place.
class CReduction_Station : public ui::DialogModel {
public:
    // The parts of the dialog a change notice names.
    enum Part : int {
        kPartSwitches = 1, // the seven check boxes
        kPartGeoBase = 2,  // the elements of the GéoBase, after a reduction
    };

    explicit CReduction_Station(CCarnet* carnet = nullptr) : m_carnet(carnet) {}
    void SetCarnet(CCarnet* carnet) { m_carnet = carnet; }
    CCarnet* Carnet() const { return m_carnet; }

    std::string Caption() const override { return kReductionCaption; }

    // Reads the switches and the calculation options it uses from the parameter file, as the dialog
    // does when it opens; the switches given (GiveSwitch) hold over those read.
    void OnInitDialog();
    // Ticks or clears the check box `which` (in the order of ReductionSwitches()). The value is given:
    // it holds over the parameter file's when the dialog opens afterwards.
    void GiveSwitch(std::size_t which, bool on);
    bool Switch(std::size_t which) const;
    // Saves the switches, reduces, and closes.
    void OnOK(ui::FrontEnd& frontEnd);
    void SaveOptions() const;

    // The switches as they stand; changed here, they are neither given nor announced.
    ReductionOptions& Options() { return m_options; }
    const ReductionOptions& Options() const { return m_options; }
    // "ExcentVertDansAngles": the vertical offsets go into the zenith angles and distances rather than the
    // target heights, and so does a difference of instrument height between merged set-ups.
    void SetFoldVertical(bool fold) { m_foldVertical = fold; }
    // The instrument of the stations that follow no instrument element.
    void SetDefaultInstrument(InstrumentOptions instrument) { m_defaultInstrument = std::move(instrument); }
    // Whether any element of the GéoBase was changed.
    bool Changed() const { return m_changed; }

    // Every step, in order; the warning is shown first. Announces the GéoBase reduced, changed or not.
    void Reduce(ui::FrontEnd& frontEnd);

    // ---- The steps. Each leaves the GéoBase as it made it; run by Reduce, the deletions are carried out
    // once at the end, and the indices of the blocks follow them.
    // Adds each instrument's vertical collimation to the zenith angles and its prism constant to the
    // distances of the stations that use it, then deletes every instrument element (1008).
    void IntegrateInstrumentCorrections();
    // The station's vertical offset into its instrument height, every sighting turned to face left and
    // reduced for its offsets, then the eccentric elements (1010) of the block deleted.
    void IntegrateEccentricities(CRepriseBlock& block);
    // Each point sighted several times from the station: its sightings averaged into the first one, the
    // others deleted.
    void MeanRepeatedSightings(CRepriseBlock& block);
    // The set-ups of that station point, in GéoBase order.
    void BuildRepriseBlocks(const std::string& name);
    const CRepriseList& Blocks() const { return m_blocks; }
    CRepriseList& Blocks() { return m_blocks; }
    // The orientation offset of blocks[b] to blocks[a] from the points both sight, added to a's links.
    void CommonSightOffset(CRepriseList& blocks, int a, int b);
    // Copies a set-up to the end of the GéoBase (from its station, or from the element after it), its
    // directions turned by `angle` and its sightings brought to an instrument `dh` metres higher.
    void AppendReprise(bool withStation, double angle, double dh, CRepriseBlock& block);
    // The index of the merged station made by the last reduction, -1 when none.
    int MergedStation() const { return m_merged; }

private:
    struct Offsets {
        double radial = 0.0, tangential = 0.0, vertical = 0.0;
    };

    bool IsRemoved(int index) const;
    int KindAt(int index) const;
    bool IsSightingAt(int index) const;
    CVisee& SightingAt(int index);
    void Remove(int index);
    void RemoveRange(int first, int last);
    void SetKind(int index, int kind);
    int NextStation(int from) const;
    int NextRepetition(const std::string& mat, int from, int end) const;

    Offsets OffsetsAt(int index, int limit) const;
    void RemoveEccentricsBefore(int index);
    void StoreSighting(CVisee& sighting, double ah, double av, double di, double hp);
    void TurnToFaceLeft(int index);
    void ReduceSighting(int index, int limit, bool faceLeft);
    double StationHeight(const CRepriseBlock& block) const;
    // How far the instrument of a set-up stands below the reference height; 0 when either is unknown.
    double HeightBelow(double reference, const CRepriseBlock& block) const;
    void SetStationHeight(int index, double hi);
    void V0Offsets(CRepriseList& blocks, int a);
    void MergeReprises(const std::string& name);

    // Carries out the pending deletions and changes of kind, and shifts the indices of the blocks (those
    // built here, the list and the block given, the block's own list) and of the merged station.
    void Settle(CRepriseBlock* block = nullptr, CRepriseList* list = nullptr);
    void EndStep(CRepriseBlock* block = nullptr, CRepriseList* list = nullptr);

    CCarnet* m_carnet;
    ReductionOptions m_options;
    // The switches given, holding over the parameter file.
    std::array<std::optional<bool>, kReductionSwitchCount> m_given;
    bool m_foldVertical = false;
    InstrumentOptions m_defaultInstrument{kStandardInstrument};
    bool m_changed = false;

    CRepriseList m_blocks;
    int m_merged = -1;
    bool m_reducing = false;     // inside Reduce: deletions wait for its end
    std::vector<char> m_removed; // deleted elements, until settled
    int m_removedCount = 0;
    std::vector<int> m_kinds; // new kinds (0: unchanged), until settled
    bool m_kindChanged = false;
};

} // namespace pyr
