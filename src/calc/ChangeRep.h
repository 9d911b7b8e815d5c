#pragma once

#include "core/LargeBlocks.h"
#include "core/Undefined.h"
#include "geobase/Elements.h"
#include "geobase/Selection.h"
#include "ui/DialogModel.h"

#include <array>
#include <cstddef>
#include <memory>
#include <memory_resource>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

// The change of planimetric reference frame of a GéoBase, in place: every point moved from frame 1 into
// frame 2 by the rotation and the translation that bring two common points of frame 1 onto the same two
// points of frame 2, without any scale factor; the orientations (V0) of the stations turned by the same
// rotation when asked.
namespace pyr {

namespace ui {
class FrontEnd;
}

class CCarnet;

inline constexpr const char* kSectionChangeRep = "Changement_Repere";

// ---- The formulas

// Two points of a frame: A then B, X the easting and Y the northing (metres).
struct CommonPoints {
    double xa, ya, xb, yb;
};

// Frame 1 from frame 2: (X1, Y1) = T + R(θ) (X2, Y2), R turning bearings by +θ. The point of frame 1 comes
// into frame 2 by IntoFrame2.
struct FrameChange {
    double rotation = 0.0;     // θ (gr): the bearing of a line in frame 1 less its bearing in frame 2
    double translationX = 0.0; // TX (m)
    double translationY = 0.0; // TY (m)
    double cosRotation = 1.0, sinRotation = 0.0;
};

// The change that brings the points of frame 1 onto those of frame 2. Two points that coincide in a frame
// give that frame's line a bearing of 0.
FrameChange FrameChangeFrom(const CommonPoints& frame1, const CommonPoints& frame2);
// A point of frame 1 in frame 2.
void IntoFrame2(const FrameChange& change, double& x, double& y);
// The foot of the perpendicular from (x, y) on the line through A and B; false, and the point left as it
// is, when A and B are less than a millimetre apart.
bool ProjectOntoLine(const CommonPoints& line, double& x, double& y);
// The orientation of a station once its frame has turned by `rotation` gr, in [0, 400).
double TurnedV0(double v0, double rotation);

// ---- The dialog's switches, kept in the section "Changement_Repere"

inline constexpr std::size_t kChangeRepSwitchCount = 7;
struct ChangeRepOptions {
    bool changeFrame = true;  // the rotation and the translation applied to the points
    bool modifyV0 = false;    // the known V0 of the stations turned
    bool allPoints = true;    // every point, else those of the selection
    bool fixedPoints = false; // the points declared invariant moved as well
    bool projection = false;  // the points first projected onto the line of frame 1's two points
    bool swapYZ = false;      // the altitude written in Y, and Y' in Z (a section along the line)
    bool keepZ = false;       // with swapYZ, the altitude also kept in Z
};

// One switch: its key, its check box, and its option on a command line ("--modif-v0 0|1").
struct ChangeRepSwitch {
    const char* key;
    bool ChangeRepOptions::*member;
    bool byDefault;
    const char* checkBox;
    const char* option;
    const char* help;
};
std::span<const ChangeRepSwitch> ChangeRepSwitches();
// The place of each switch in ChangeRepSwitches().
enum ChangeRepSwitchIndex : std::size_t {
    kSwitchChangeFrame,
    kSwitchModifyV0,
    kSwitchAllPoints,
    kSwitchFixedPoints,
    kSwitchProjection,
    kSwitchSwapYZ,
    kSwitchKeepZ,
};

// An element the change rewrote, for the editor's undo: its index and a copy of the state that is not in
// the GéoBase, the store holding the other. Once the change is made, the copy is the element before it;
// Exchange puts it back and keeps the element after the change instead, and exchanging again redoes the
// change. Both states are kept for one copy.
struct ElementChange {
    int index;
    std::unique_ptr<CElement> other;

    // Undoes or redoes the change: false, and nothing changed, when the GéoBase no longer holds an element
    // of that kind at that index.
    bool Exchange(CCarnet& carnet);
};
// The records of a change, a million for a big job: kept in blocks of huge pages (LargeBlocks()), which the
// first change of a process maps in a few page faults.
using ElementChanges = std::pmr::vector<ElementChange>;

// The dialog "Changement de repère", opened by the GéoBase editor on the GéoBase it holds: the two common
// points in both frames (eight fields), the rotation and the translation computed at every edit, the
// switches, kept in the parameter file, the selection, and OK, which moves the points in place.
class CChange_Rep : public ui::DialogModel {
public:
    // The parts of the dialog a change notice names.
    enum Part : int {
        kPartFields = 1,    // the eight fields, the distances, the results and OK's state
        kPartSwitches = 2,  // the check boxes
        kPartSelection = 4, // the selection text
        kPartGeoBase = 8,   // the elements of the GéoBase, after OK
    };
    // The eight fields: frame 1's XA, YA, XB, YB, then frame 2's.
    static constexpr int kFieldCount = 8;

    explicit CChange_Rep(CCarnet* carnet = nullptr) : m_carnet(carnet) {}
    void SetCarnet(CCarnet* carnet) { m_carnet = carnet; }
    CCarnet* Carnet() const { return m_carnet; }

    std::string Caption() const override;

    // Reads the switches from the parameter file and the store's decimals, as the dialog does when it
    // opens; the switches given (GiveSwitch) hold over those read.
    void OnInitDialog();
    void GiveSwitch(std::size_t which, bool on);
    bool Switch(std::size_t which) const;
    ChangeRepOptions& Options() { return m_options; }
    const ChangeRepOptions& Options() const { return m_options; }
    void SaveOptions() const;

    // A field typed: an empty text is undefined. False when the text is no number (the field is then
    // undefined too); the distances and the results are computed again.
    bool SetField(int which, std::string_view text);
    const std::string& FieldText(int which) const { return m_texts.at(static_cast<std::size_t>(which)); }
    double Field(int which) const { return m_values.at(static_cast<std::size_t>(which)); }
    // Both frames complete: the results are shown and OK is enabled.
    bool CanOK() const { return m_complete; }
    // "Distance dans le repère 1 = ..." for each complete frame, with their difference when both are.
    const std::string& DistanceStatus() const { return m_status; }
    // The results as shown ("%.5f" gr, "%.4f" m); empty until both frames are complete.
    std::string RotationText() const;
    std::string TranslationXText() const;
    std::string TranslationYText() const;
    const FrameChange& Change() const { return m_change; }

    void SetSelection(std::string text);
    const std::string& Selection() const { return m_selection; }

    // Saves the switches and moves the points: false, and nothing changed, when OK is not enabled or the
    // selection is not correct (a message said so: the selection is to be typed again).
    bool OnOK(ui::FrontEnd& frontEnd);
    // The points and stations changed, the closing message left to the caller: false when refused.
    bool Apply(ui::FrontEnd& frontEnd);

    int PointsComputed() const { return m_points; }
    int StationsTurned() const { return m_stations; }
    bool Changed() const { return m_points > 0 || m_stations > 0; }
    // The elements rewritten by the last OK, in GéoBase order; taken by the editor.
    ElementChanges& Changes() { return m_changes; }

private:
    std::optional<CommonPoints> Frame(int frame) const;
    void Recompute();
    // Whether a point or station of that identifier is to be changed (the selection rule).
    bool Selected(std::string_view mat) const { return !m_chosen || m_chosen->Contains(mat); }
    bool MovePoint(int index);
    bool TurnStation(int index);

    CCarnet* m_carnet;
    ChangeRepOptions m_options;
    std::array<std::optional<bool>, kChangeRepSwitchCount> m_given;
    std::array<std::string, kFieldCount> m_texts;
    std::array<double, kFieldCount> m_values{kUndefined, kUndefined, kUndefined, kUndefined,
                                             kUndefined, kUndefined, kUndefined, kUndefined};
    std::string m_selection;
    std::optional<CSelection> m_chosen; // the selection read by OK, unless every point is changed

    bool m_complete = false;
    FrameChange m_change;
    CommonPoints m_line{}; // the projection line: frame 1's two points
    std::string m_status;

    int m_points = 0;
    int m_stations = 0;
    ElementChanges m_changes{LargeBlocks()};
};

} // namespace pyr
