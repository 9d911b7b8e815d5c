#include "calc/CalcNiv.h"

#include "calc/LevellingListing.h"
#include "calc/LevellingTexts.h"
#include "calc/SessionTexts.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/Kinds.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>
#include <cmath>

namespace pyr {

namespace {

// Misclosures and tolerances shown to the tenth of a millimetre.
constexpr int kDecimals = 4;

std::string Metres(double value) {
    return FormatFixedShown(value, kDecimals);
}

bool HasStaffReading(const CCarnet& carnet) {
    for (int i = 0; i < carnet.GetSize(); ++i)
        if (IsLevellingKind(carnet.GetType(i))) return true;
    return false;
}

} // namespace

CCalcNiv::CCalcNiv(LevellingMethod method)
    : m_method(method),
      m_session({method == LevellingMethod::DoubleStation ? niv::kJournalDouble : niv::kJournalSimple,
                 session::kQuestionInvariantXY, session::kQuestionInvariantZ}) {
    m_options.method = method;
}

std::string CCalcNiv::Caption() const {
    return m_method == LevellingMethod::DoubleStation ? niv::kCaptionDouble : niv::kCaptionSimple;
}

bool CCalcNiv::Open(ui::FrontEnd& frontEnd) {
    m_frontEnd = &frontEnd;
    m_runs.clear();
    m_problems.clear();
    m_written = false;
    if (!m_session.Open(frontEnd, *this)) {
        m_cancelled = m_session.Cancelled();
        return false;
    }
    m_options = LevellingOptions::FromOptions(m_session.ParamPath(), m_method);
    if (!HasStaffReading(m_session.Carnet())) {
        frontEnd.MessageBox(Sprintf(niv::kMsgNoReading, m_session.Path().c_str()), ui::kCaption,
                            ui::kIconWarning);
        return false;
    }
    m_setUps = ReadLevellingSetUps(m_session.Carnet());
    return true;
}

std::string CCalcNiv::Close(bool, bool listingAsked, std::string listingPath) {
    ListingRequest request;
    request.kind = m_method == LevellingMethod::DoubleStation ? ListingKind::LevellingDoubleRun
                                                              : ListingKind::LevellingSimple;
    request.resultCount = m_runs.size();
    request.writeResult = [this](CDlgCfgListing& listing, std::size_t index) {
        WriteLevellingRun(listing, m_runs[index], m_options);
        if (index + 1 == m_runs.size()) WriteLevellingProblems(listing, m_problems);
    };
    request.writeTolerances = [this](CDlgCfgListing& listing) {
        WriteLevellingTolerances(listing, m_options);
    };
    request.ask = !listingAsked;
    request.path = std::move(listingPath);
    return m_session.Close(std::move(request));
}

std::vector<std::string> CCalcNiv::Benchmarks() const {
    std::vector<std::string> names;
    const CCarnet& carnet = m_session.Carnet();
    const auto add = [&](const std::string& point) {
        if (carnet.hasZ(point) && std::find(names.begin(), names.end(), point) == names.end())
            names.push_back(point);
    };
    for (const std::vector<LevellingSetUp>& block : m_setUps.blocks)
        for (const LevellingSetUp& setUp : block) {
            add(setUp.backPoint);
            add(setUp.forwardPoint);
        }
    return names;
}

bool CCalcNiv::Chosen(const LevellingRun& run) const {
    return (m_start.empty() || run.start == m_start) && (m_end.empty() || run.end == m_end);
}

void CCalcNiv::Show(const LevellingRun& run) {
    CPyrTxtWnd txt(*m_frontEnd);
    const std::string length = IsKnown(run.length) ? FormatFixedShown(run.length, 3) : niv::kUnknownLength;
    txt.Print(niv::kLineRun, run.start.c_str(), run.end.c_str(), run.closedLoop ? niv::kClosedMark : "",
              static_cast<int>(run.steps.size()), length.c_str());
    txt.Print(niv::kLineClosure, Metres(run.misclosure).c_str(), Metres(run.tolerance).c_str(),
              run.inTolerance ? "" : niv::kOutOfTolerance);
    for (const std::string& warning : run.warnings)
        txt.Print(niv::kLineWarning, warning.c_str());
}

bool CCalcNiv::Calculate() {
    if (!m_frontEnd || !m_session.IsOpen()) return false;
    m_runs.clear();
    m_written = false;
    m_options.start = m_start;
    m_options.end = m_end;
    LevellingResult result = ComputeLevelling(m_session.Carnet(), m_setUps, m_options);
    m_problems = std::move(result.problems);
    CPyrTxtWnd txt(*m_frontEnd);
    for (const std::string& problem : m_problems)
        txt.Print(niv::kLineProblem, problem.c_str());
    for (LevellingRun& run : result.runs)
        if (Chosen(run)) m_runs.push_back(std::move(run));
    for (const LevellingRun& run : m_runs)
        Show(run);
    if (m_runs.empty()) {
        if (result.runs.empty()) {
            m_frontEnd->MessageBox(niv::kMsgNothingComputed, ui::kCaption, ui::kIconWarning);
        } else {
            std::string choice;
            if (!m_start.empty()) choice = Sprintf(niv::kChoiceStart, m_start.c_str());
            if (!m_end.empty())
                choice += (choice.empty() ? "" : ", ") + Sprintf(niv::kChoiceEnd, m_end.c_str());
            m_frontEnd->MessageBox(Sprintf(niv::kMsgNoRunChosen, choice.c_str()), ui::kCaption,
                                   ui::kIconWarning);
        }
    }
    Notify(kPartResults);
    return !m_runs.empty();
}

bool CCalcNiv::Write(const LevellingRun& run, int& written) {
    std::string text;
    if (!run.inTolerance)
        text = Sprintf(niv::kQuestionOutOfTolerance, run.start.c_str(), run.end.c_str(),
                       Metres(run.misclosure).c_str(), Metres(run.tolerance).c_str());
    else if (run.flagged)
        text = Sprintf(niv::kQuestionFlagged, run.start.c_str(), run.end.c_str());
    if (!text.empty() &&
        m_frontEnd->Ask(text, ui::kCaption, ui::Buttons::YesNo, ui::Answer::No) != ui::Answer::Yes) {
        CPyrTxtWnd(*m_frontEnd).Print(niv::kLineNotWritten, run.start.c_str(), run.end.c_str());
        return false;
    }
    // The benchmarks at both ends keep their heights; a side point already known is a check, kept too.
    for (std::size_t i = 0; i < run.steps.size(); ++i) {
        const LevellingStep& step = run.steps[i];
        if (i + 1 < run.steps.size() && m_session.WritePoint(step.to, kUndefined, kUndefined, step.zTo))
            ++written;
        for (const LevellingSetUp& setUp : step.setUps)
            for (const LevellingSideReading& side : setUp.sides)
                if (!IsKnown(side.knownZ) && m_session.WritePoint(side.point, kUndefined, kUndefined, side.z))
                    ++written;
    }
    return true;
}

bool CCalcNiv::Enregistrer() {
    if (!m_frontEnd || !m_session.IsOpen()) return false;
    CPyrTxtWnd txt(*m_frontEnd);
    int written = 0;
    if (!m_written)
        for (const LevellingRun& run : m_runs)
            Write(run, written);
    m_written = true;
    if (!m_session.Modified()) {
        txt.PrintText(msg::kNoChange);
        return true;
    }
    if (!m_session.Save()) return false;
    txt.Print(niv::kLineWritten, written);
    Notify(kPartResults);
    return true;
}

} // namespace pyr
