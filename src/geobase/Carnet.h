#pragma once

#include "geobase/CarnetIndex.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"

#include <cstdio>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pyr {

class CPyrTxtWnd;
namespace ui {
class FrontEnd;
}

// A GéoBase in memory: the ordered elements of a field book (stations, sightings, points, levelling
// readings, traverses, instruments, comments, codification commands), each with its kind code.
// Elements are addressed by their index from 0 (shown to a person from 1). The element array and the
// kind array always have the same length: every change goes through the operations below.
class CCarnet {
public:
    CCarnet();
    ~CCarnet();
    CCarnet(const CCarnet& other);
    CCarnet& operator=(const CCarnet& other);
    CCarnet(CCarnet&& other) noexcept;
    CCarnet& operator=(CCarnet&& other) noexcept;

    // ---- The two arrays
    int GetSize() const { return static_cast<int>(m_elements.size()); }
    bool IsEmpty() const { return m_elements.empty(); }
    bool IsValidIndex(int index) const { return index >= 0 && index < GetSize(); }
    const CElement* GetAt(int index) const;
    CElement* GetAt(int index);
    int GetType(int index) const; // the kind code, 0 outside the store
    // The element at that index as a given class, or nullptr.
    template <class T>
    T* As(int index) {
        return dynamic_cast<T*>(GetAt(index));
    }
    template <class T>
    const T* As(int index) const {
        return dynamic_cast<const T*>(GetAt(index));
    }

    // Appends an element with its kind and returns its index; -1 (and the element is dropped) when the
    // element cannot stand under that kind.
    int Add(std::unique_ptr<CElement> element, int kind);
    int InsertAt(int index, std::unique_ptr<CElement> element, int kind);
    // Removes the element and its kind at that index.
    void removeElement(int index);
    // Removes the element at that index and hands it over with its kind (an edit that may be undone keeps
    // it); null, and nothing changed, outside the store.
    std::unique_ptr<CElement> TakeAt(int index, int& kind);
    // Elements taken out of the store together, each with its kind and the index it had.
    struct Taken {
        int index = -1;
        int kind = 0;
        std::unique_ptr<CElement> element;
    };
    // Removes the elements at those indices (increasing, each once, inside the store) in one pass over
    // the store, and hands them over: removing a hundred thousand elements found by a search must not
    // move the million others a hundred thousand times.
    std::vector<Taken> TakeMany(const std::vector<int>& indices);
    // Puts elements taken by TakeMany back at their indices, in one pass. False, and nothing changed, when
    // they cannot stand there (an index beyond the store once the others are back).
    bool PutBackMany(std::vector<Taken>& taken);
    // Removes the elements of [first, last).
    void RemoveRange(int first, int last);
    void RemoveAll();
    // Moves every element of `other`, in order, to the end of this store; `other` is left empty.
    void Append(CCarnet&& other);
    // Changes the kind at an index between the kinds that share a class: reference and measured
    // sighting, back and fore reading, the codification commands. False when the change is not one.
    bool SetKindAt(int index, int kind);

    // A new copy of the element at that index, owned by the caller; with a kind (1002 or 1003, 1004 or
    // 1005), the copy is of that kind's class. Null outside the store.
    std::unique_ptr<CElement> copyElement(int index, int kind = -1) const;
    // Puts `element` in the place of the element at that index, under the same kind, and hands the one that
    // was there back in `element`: an element's two states exchanged without a copy. False, and nothing
    // changed, outside the store or when the element cannot stand under that kind.
    bool ExchangeAt(int index, std::unique_ptr<CElement>& element);

    // ---- Accessors by index: the value when the element there has it, else kUndefined (or "")
    std::string matAt(int index) const;
    std::string cmdAt(int index) const;
    std::string symAt(int index) const;
    std::string parAt(int index) const;
    double xAt(int index) const;
    double yAt(int index) const;
    double zAt(int index) const;
    double ahAt(int index) const;
    double avAt(int index) const;
    double diAt(int index) const;
    double dhAt(int index) const; // sighting: DI sin AV; levelling reading: its distance
    double hiAt(int index) const;
    double hpAt(int index) const;
    double v0At(int index) const;
    double lmAt(int index) const;
    // The altitude of the point of that identifier (first occurrence holding one), or kUndefined;
    // by index, of the point that the element there names.
    double zFor(std::string_view mat) const;
    double zFor(int index) const;

    // ---- Look-ups (indexed: processing every station or point of a GéoBase is linear)
    // The next element of that kind and identifier from `start`, forwards (direction 0) or backwards
    // (direction -1), -1 when there is none. An empty identifier matches every element of the kind.
    int Find(int kind, std::string_view mat, int start = 0, int direction = 0) const;
    int findMat(std::string_view mat) const; // first point (1006) of that identifier
    // The elements bearing the identifier of the element at `index`, itself included, in increasing
    // order, found without searching for the identifier; empty for an element without one. Valid until
    // the GéoBase changes.
    const std::vector<int>& SameMat(int index) const;
    // The rank of that identifier among the GéoBase's identifiers (in the order of their first element),
    // -1 without: a key as dense as the identifiers are many. NameCount() is one past the last rank.
    int NameRank(int index) const;
    int NameCount() const;
    int lastInd(std::string_view mat) const; // last point of that identifier
    bool hasPnt(std::string_view mat) const;
    bool hasPnt(int index) const;
    bool hasXY(std::string_view mat) const;
    bool hasXY(std::string_view mat, double& x, double& y) const;
    bool hasXY(int index) const;
    bool hasZ(std::string_view mat) const;
    bool hasZ(std::string_view mat, double& z) const;
    bool hasZ(int index) const;

    // Stations and their reprises (numbered from 1 in GéoBase order).
    int findStaRep(std::string_view name, int reprise) const;
    static bool extrStaRep(std::string_view text, std::string& name, int& reprise);
    int RepriseAt(int stationIndex) const;                  // 0 when the element is not a station
    std::string StationDesignation(int stationIndex) const; // "%s(%d)"
    // The station occurrence to which the element at that index belongs (the nearest station before
    // it), with the station's name; -1 when none.
    int findRepAt(int index, std::string& name) const;
    int CountStations() const;
    // Whether the store holds a station, without indexing it: a reader appending a million sightings
    // asks it for each of them.
    bool HasStation() const;

    // The instrument in force at an index (the nearest one before it), or null: the caller then uses
    // the default instrument of its options.
    const CAppareil* findAppAt(int index) const;

    // The radial, tangential and vertical eccentric offsets (metres) that apply to the element at
    // `index`: the "ExcentRad" / "ExcentTan" / "ExcentVer" commands written in front of it, searched
    // backwards down to `limit` (excluded) and never beyond the preceding observation or point.
    // 0 when there is none. findEV(station, -1) is the vertical offset of the station itself.
    double findER(int index, int limit) const;
    double findET(int index, int limit) const;
    double findEV(int index, int limit) const;

    // Whether the sighting at `sighting` carries altimetry from the station at `station`: a zenith
    // angle, a slope distance, a target height and the station's instrument height all known.
    bool isObsAltiAt(int sighting, int station) const;

    // ---- Point identifiers
    static void formMat(std::string& mat);
    static void formMat(std::string& mat, std::string_view prefix, long long number, int minDigits);
    static bool extrMat(std::string_view mat, std::string& prefix, long long& number);
    // The next identifier after the given one that no element of the store uses.
    std::string nextMat(std::string_view mat) const;
    std::string nextMat(long long number) const;
    static bool DDX_Mat(ui::FrontEnd* parent, bool saveAndValidate, std::string& fieldText,
                        std::string& value);
    static bool DDV_Mat(ui::FrontEnd* parent, std::string_view mat);

    // ---- Selection strings ("100-150, A1-A9 P7")
    static bool IsValidSelString(std::string_view text);
    static long long GetSelStringCount(std::string_view text);
    static bool IsPointInSel(std::string_view mat, std::string_view text);

    // ---- Validation of elements built from outside (field books, editor): each checks the element,
    // writes the reasons of a refusal to the text window, and appends the element when it is right.
    // Returns the element kept (now owned by the store) or null. With `report`, the addition itself is
    // written to the text window ("Station <S1> ajoutée dans la GéoBase").
    CStation* validStation(CPyrTxtWnd* txt, std::unique_ptr<CStation> station, bool report = false);
    CReference* validReference(CPyrTxtWnd* txt, std::unique_ptr<CReference> sighting, bool report = false);
    CMesure* validMesure(CPyrTxtWnd* txt, std::unique_ptr<CMesure> sighting, bool report = false);
    CPointGen* validPoint(CPyrTxtWnd* txt, std::unique_ptr<CPointGen> point, bool report = false);
    // Splits a comment line "label = value" into its parts (blanks around them dropped); false when the
    // line holds no " = ".
    static bool validComment(std::string_view line, std::string& label, std::string& value);
    // Appends the comment "label = value", the label padded with blanks to `labelWidth`.
    CComment* validComment(int labelWidth, std::string_view label, std::string_view value);

    // ---- Editing
    // Disables an element by turning it into a comment that keeps its whole line, and enables it back.
    bool changeObjectIntoComment(CPyrTxtWnd* txt, int index);
    bool changeCommentIntoObject(CPyrTxtWnd* txt, int index);
    // Converts every coordinate from one projection system to another.
    bool Projection(std::string_view from, std::string_view to, ui::FrontEnd* parent = nullptr);

    // ---- Files
    // Reads the GéoBase at `path`, replacing the contents. Lines that cannot be read are reported in the
    // text window with their number and kept as comments. A read-only file is said to be so in the text
    // window; a file that is not a GéoBase (see GeoFileCensus) is shown all the same, said to be foreign,
    // and remembered as such so that no save replaces it. `configuration` names the code table the
    // GéoBase goes with, kept for the editor; with `report`, a summary line is written. Returns 1 when
    // the file was read, 0 when it could not be opened (the store is then left empty).
    int Load(CPyrTxtWnd* txt, const std::string& path, const std::string& configuration = {}, int report = 0,
             ui::FrontEnd* parent = nullptr);
    // Writes the whole store to `path`, atomically (a temporary file of a name no file holds, beside it,
    // then renamed over it, with its access rights). Refused, leaving the file as it is, when `path` is
    // read-only or holds something else than a GéoBase. A refusal or a failure is always reported, with
    // its reason, as a failure of the running command; with `report`, so is the success. Returns 1 on
    // success.
    int Save(const std::string& path, ui::FrontEnd* parent = nullptr, bool report = false);
    // Keeps a copy of the GéoBase file as it is before it is overwritten ("chantier.geo" gives
    // "chantier.bak"), replacing the former copy whole or not at all. Returns 1 when there was nothing to
    // keep or the copy was made; 0, reported as Save reports, when the file may not be saved over (as
    // Save would refuse it, so that the refusal comes before the copy) or the copy failed: the caller
    // then does not save.
    int BackUp(ui::FrontEnd* parent = nullptr);
    // Writes the whole store to an open text file, with the format's header line when asked.
    bool Write(std::FILE* file, bool withHeader = true) const;
    // Why the store may not be written to `path` (read-only, or a file that is not a GéoBase: a field book,
    // a listing), as the sentences that follow a failure's first line; empty when it may.
    std::string SaveRefusal(const std::string& path) const;
    // Whether the file last loaded, still the store's path, was found not to be a GéoBase.
    bool LoadedFileIsForeign() const { return m_knownForeign && m_knownPath == m_path; }

    const std::string& PathName() const { return m_path; }
    void SetPathName(std::string path) { m_path = std::move(path); }
    const std::string& Configuration() const { return m_configuration; }

    // ---- Decimals settings: used to round values to what the surveyor asked for
    static int DeciXY() { return s_deciXY; }
    static int DeciZ() { return s_deciZ; }
    static int DeciAng() { return s_deciAng; }
    static void setDeciXY(int n) { s_deciXY = n; }
    static void setDeciZ(int n) { s_deciZ = n; }
    static void setDeciAng(int n) { s_deciAng = n; }
    static double formatXY(double value);
    static double formatZ(double value);
    static double formatAng(double value);

private:
    const CarnetIndex& Index() const;
    void Changed() {
        m_index.Invalidate();
        m_noStationBefore = 0;
    }
    // Appends without checking the kind: for elements built here for their kind.
    void AddChecked(std::unique_ptr<CElement> element, int kind);
    void Keep(CPyrTxtWnd* txt, std::unique_ptr<CElement> element, int kind, bool report);
    double FindEccentric(std::string_view word, int index, int limit) const;

    std::vector<std::unique_ptr<CElement>> m_elements;
    std::vector<int> m_kinds;
    mutable CarnetIndex m_index;
    // HasStation's memory: a station found there (checked again before it is believed), and the
    // elements before m_noStationBefore hold none (forgotten at every change but an append).
    mutable int m_stationSeen = -1;
    mutable std::size_t m_noStationBefore = 0;
    bool IsForeignFile(const std::string& path) const;

    std::string m_path;
    std::string m_configuration;
    // What is known of the file at m_knownPath (the one loaded or last saved): whether it is foreign.
    // Saving over that file needs no second look at it, which for a big GéoBase would mean reading it.
    std::string m_knownPath;
    bool m_knownForeign = false;

    static inline int s_deciXY = 4;
    static inline int s_deciZ = 3;
    static inline int s_deciAng = 5;
};

} // namespace pyr
