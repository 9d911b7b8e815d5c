#pragma once

#include "calc/SightingReduction.h"
#include "calc/Tolerances.h"
#include "geobase/Carnet.h"
#include "settings/Journal.h"
#include "settings/ListingFlow.h"
#include "ui/DialogModel.h"

#include <memory>
#include <string>
#include <string_view>

// What every computation dialog does around its own computation: it offers the last GéoBase, loads it and
// reads the calculation options, reduces sightings with them, writes points and stations back into the
// GéoBase (asking before it replaces invariant coordinates) with a line of the journal for each, saves
// the GéoBase and remembers it as the last one, and on closing offers the listing and completes the
// journal. A dialog holds one session for its life.
namespace pyr {

namespace ui {
class FrontEnd;
}

// The words a computation gives the session: which journal it writes, which questions protect what.
struct SessionWords {
    const char* journal;     // "Calcul de points par intersection"
    const char* invariantXY; // the question before replacing invariant X and Y ("%s": the name)
    const char* invariantZ;  // the same for an invariant altitude
};

class CComputationSession {
public:
    explicit CComputationSession(SessionWords words) : m_words(words) {}

    // ---- Opening
    // Offers the GéoBase of the inputs (the last one used) to be confirmed or changed unless the person
    // named it, loads it, reads the options (the store's decimals and axis order, tolerances, the
    // reduction of sightings) and says when the automatic scale correction cannot use its projection.
    // False, a message having said why, when no GéoBase is given, it cannot be read or it is empty;
    // Cancelled() tells whether the person chose none.
    bool Open(ui::FrontEnd& frontEnd, ui::DialogModel& dialog);
    bool Cancelled() const { return m_cancelled; }
    bool IsOpen() const { return m_frontEnd != nullptr && m_open; }

    ui::FrontEnd& FrontEnd() const { return *m_frontEnd; }
    CCarnet& Carnet() { return m_carnet; }
    const CCarnet& Carnet() const { return m_carnet; }
    const std::string& Path() const { return m_path; }
    std::string_view ParamPath() const { return m_paramPath; }

    // ---- The options read when the session opened
    SightingReductionOptions& Reduction() { return m_reduction; }
    const SightingReductionOptions& Reduction() const { return m_reduction; }
    const Tolerances& Tolerance() const { return m_tolerances; }

    // ---- Writing back
    // Writes a computed point (any of X/Y or Z may be kUndefined: that part is left alone), creating it
    // when the GéoBase has no point of that name. Each value is kept to 4 decimals. Invariant X and Y, or
    // an invariant altitude, are replaced only when the person agrees. The journal gets the point's line.
    // False, with the refusal message, when the GéoBase refuses it (nothing changed).
    bool WritePoint(std::string_view mat, double x, double y, double z);
    // Writes a station's V0 and its journal line.
    bool WriteStationV0(int stationIndex, std::string_view designation, double v0);
    // A change of the GéoBase made by the dialog itself (a point added from typed coordinates).
    void MarkModified() { m_modified = true; }
    bool Modified() const { return m_modified; }
    CJournal& Journal() { return *m_journal; }

    // Backs the GéoBase up, saves it and remembers it as the last one. False when it could not be saved
    // (a message said why; nothing is lost: the file on disk is the one before).
    bool Save();
    // On leaving with changes not saved: "La GéoBase courante a été modifiée !\nVoulez vous
    // l'enregistrer ?", and the save on Yes. False when the person said yes and it could not be saved.
    bool OfferSave();

    // ---- Closing
    // The listing of the results held (ListingFlow.h), then the journal when something was written and
    // the surveyor wants one. Returns the listing's path, or "".
    std::string Close(ListingRequest listing);

private:
    SessionWords m_words;
    ui::FrontEnd* m_frontEnd = nullptr;
    bool m_open = false;
    bool m_cancelled = false;
    CCarnet m_carnet;
    std::string m_path;
    std::string m_paramPath;
    SightingReductionOptions m_reduction;
    Tolerances m_tolerances;
    std::unique_ptr<CJournal> m_journal;
    bool m_modified = false; // changed since it was last saved
    bool m_saved = false;    // saved at least once with something written
};

} // namespace pyr
