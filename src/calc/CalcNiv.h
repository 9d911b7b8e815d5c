#pragma once

#include "calc/ComputationSession.h"
#include "calc/Levelling.h"
#include "ui/DialogModel.h"

#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// The dialogs "PYRALIS - Calcul de cheminement altimétrique" (simple levelling) and "PYRALIS - Calcul de
// nivellement par double station": the staff readings of the GéoBase (back 1004, forward 1005) chained into
// runs between benchmarks of known height, those chosen by their start and end (every run by default)
// computed, their misclosures checked against the tolerance of "Options_Nivellement" and distributed;
// "&Enregistrer" writes the heights of their turning points and side points into the GéoBase (a run out of
// tolerance, or with a double-station pair out of tolerance, only when the person agrees); the listing
// (".cns" or ".cna") and the journal report them.
class CCalcNiv : public ui::DialogModel {
public:
    static constexpr int kPartResults = 1;

    explicit CCalcNiv(LevellingMethod method);
    std::string Caption() const override;
    LevellingMethod Method() const { return m_method; }

    // ---- Opening and closing
    // Offers the GéoBase, loads it and reads the options. False, a message having said why, when it holds
    // no staff reading or when the person chose no GéoBase.
    bool Open(ui::FrontEnd& frontEnd);
    bool Cancelled() const { return m_cancelled; }
    std::string Close(bool saved, bool listingAsked = false, std::string listingPath = {});

    // ---- The choice: the runs leaving that benchmark and those reaching that one; "" for any.
    void Choose(std::string start, std::string end) {
        m_start = std::move(start);
        m_end = std::move(end);
    }
    const std::string& Start() const { return m_start; }
    const std::string& End() const { return m_end; }
    // The turning points of the readings whose height the GéoBase knows, where runs may start and end:
    // in the order of the readings, each once.
    std::vector<std::string> Benchmarks() const;
    LevellingOptions& Options() { return m_options; }

    // ---- Actions
    // "&Calculer": true when at least one run was computed.
    bool Calculate();
    // "&Enregistrer": false when the GéoBase could not be saved.
    bool Enregistrer();

    const std::vector<LevellingRun>& Runs() const { return m_runs; }
    const std::vector<std::string>& Problems() const { return m_problems; }
    const CCarnet& Carnet() const { return m_session.Carnet(); }

private:
    bool Chosen(const LevellingRun& run) const;
    void Show(const LevellingRun& run);
    // The run's heights written; false when the person kept it out.
    bool Write(const LevellingRun& run, int& written);

    LevellingMethod m_method;
    ui::FrontEnd* m_frontEnd = nullptr;
    bool m_cancelled = false;
    CComputationSession m_session;
    LevellingOptions m_options;
    LevellingSetUps m_setUps;
    std::string m_start, m_end;
    std::vector<LevellingRun> m_runs;
    std::vector<std::string> m_problems;
    bool m_written = false;
};

} // namespace pyr
