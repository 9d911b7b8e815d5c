#include "fieldbook/PointExport.h"

#include "core/Files.h"
#include "core/SafeFile.h"
#include "core/Strings.h"
#include "geobase/Carnet.h"
#include "geobase/Matricule.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>
#include <cerrno>

namespace pyr {

namespace {

inline constexpr const char* kWhyRangeWithoutNumber =
    "le matricule « %s » n'a pas de numéro : une plage va d'un matricule numéroté à un autre";
inline constexpr const char* kWhyRangePrefixes = "les deux bornes de la plage n'ont pas le même préfixe";
inline constexpr const char* kWhyRangeReversed =
    "plage à l'envers, le premier numéro est plus grand que le dernier";
inline constexpr const char* kMsgPointNotExported = "Point <%s> non exporté : %s.";
inline constexpr const char* kMsgPointsLeftOut =
    "%d point(s) non exporté(s) : le format du fichier ne peut pas les écrire.\n"
    "Voir la fenêtre de texte.";
inline constexpr const char* kMsgSettingsMissing = "Le fichier de paramètres d'export <%s> n'existe pas !";
inline constexpr const char* kMsgSettingsUnreadable =
    "Impossible de lire le fichier de paramètres d'export <%s> !\n(%s)";
inline constexpr const char* kMsgSettingsNotNamed = "Aucun fichier de paramètres d'export n'est indiqué !";
inline constexpr const char* kMsgBadSetting =
    "Fichier de paramètres d'export <%s> :\nvaleur « %s » incorrecte pour %s (valeurs possibles : %s) !";

} // namespace

std::optional<IdentifierRange> IdentifierRange::Make(std::string_view from, std::string_view to,
                                                     std::string* why) {
    IdentifierRange range;
    std::string toPrefix;
    const auto refuse = [why](std::string text) {
        if (why) *why = std::move(text);
        return std::nullopt;
    };
    if (!CCarnet::extrMat(from, range.m_prefix, range.m_first))
        return refuse(Sprintf(kWhyRangeWithoutNumber, std::string(from).c_str()));
    if (!CCarnet::extrMat(to, toPrefix, range.m_last))
        return refuse(Sprintf(kWhyRangeWithoutNumber, std::string(to).c_str()));
    if (toPrefix != range.m_prefix) return refuse(kWhyRangePrefixes);
    if (range.m_first > range.m_last) return refuse(kWhyRangeReversed);
    return range;
}

bool IdentifierRange::Contains(std::string_view mat) const {
    const MatParts parts = SplitMat(FormMatView(mat));
    return parts.number >= 0 && parts.prefix == m_prefix && parts.number >= m_first && parts.number <= m_last;
}

std::vector<bool> ElementsInScope(const PointExportJob& job) {
    const CCarnet& carnet = *job.carnet;
    const auto size = static_cast<std::size_t>(carnet.GetSize());
    std::vector<bool> chosen(size, job.selection == nullptr);
    if (job.selection) {
        for (int reference : *job.selection) {
            const bool observation = reference >= kObservationReference;
            const int index = observation ? reference - kObservationReference : reference;
            // A reference of the other kind than the element's designates nothing.
            if (!carnet.IsValidIndex(index) || (carnet.GetType(index) == kKindPoint) == observation) continue;
            chosen[static_cast<std::size_t>(index)] = true;
        }
    }
    if (job.range)
        for (std::size_t i = 0; i < size; ++i)
            if (chosen[i] && !job.range->Contains(carnet.GetAt(static_cast<int>(i))->mat()))
                chosen[i] = false;
    return chosen;
}

std::vector<int> ExportedPoints(const PointExportJob& job) {
    const CCarnet& carnet = *job.carnet;
    const std::vector<bool> chosen = ElementsInScope(job);
    std::vector<int> points;
    for (int i = 0; i < carnet.GetSize(); ++i)
        if (carnet.GetType(i) == kKindPoint && chosen[static_cast<std::size_t>(i)]) points.push_back(i);
    return points;
}

ui::FrontEnd& ExportFrontEnd(const PointExportJob& job) {
    return job.parent ? *job.parent : ui::ApplicationFrontEnd();
}

ExportFile::ExportFile(const PointExportJob& job)
    : m_job(job),
      m_writer(job.path, job.append ? SafeFileWriter::Start::CopyOfFile : SafeFileWriter::Start::Empty) {
    m_text.reserve(kChunk + (kChunk >> 4));
}

void ExportFile::Drain() {
    if (m_text.empty()) return;
    if (watch) watch(m_text);
    m_writer.Write(m_text);
    m_text.clear();
}

void ExportFile::Write(std::string_view bytes) {
    Drain();
    if (watch) watch(bytes);
    m_writer.Write(bytes);
}

bool ExportFile::Commit() {
    Drain();
    if (m_writer.Error() == 0 && m_writer.Commit()) return true;
    ExportFrontEnd(m_job).ReportFailure(m_writer.FailureText());
    return false;
}

bool CheckExportSettingsFile(const PointExportJob& job) {
    ui::FrontEnd& frontEnd = ExportFrontEnd(job);
    if (job.paramFile.empty()) {
        frontEnd.ReportFailure(kMsgSettingsNotNamed);
        return false;
    }
    if (!FileExists(job.paramFile)) {
        frontEnd.ReportFailure(Sprintf(kMsgSettingsMissing, job.paramFile.c_str()));
        return false;
    }
    std::string bytes;
    if (!ReadWholeFile(job.paramFile, bytes)) {
        const int code = errno != 0 ? errno : EIO;
        frontEnd.ReportFailure(
            Sprintf(kMsgSettingsUnreadable, job.paramFile.c_str(), SystemErrorText(code).c_str()));
        return false;
    }
    return true;
}

std::string ExportSetting(const CParamFile& file, const char* key, const char* defaultValue) {
    std::string value;
    file.ReadString(fb::kExportSection, key, defaultValue, value);
    const std::string_view trimmed = Trimmed(value);
    return trimmed.empty() ? std::string(defaultValue) : std::string(trimmed);
}

void ReportBadExportSetting(const PointExportJob& job, std::string_view key, std::string_view value,
                            std::string_view allowed) {
    ExportFrontEnd(job).ReportFailure(Sprintf(kMsgBadSetting, job.paramFile.c_str(),
                                              std::string(value).c_str(), std::string(key).c_str(),
                                              std::string(allowed).c_str()));
}

void ExportRefusals::Refuse(std::string_view mat, std::string_view why) {
    ++m_count;
    if (m_job.txt) m_job.txt->Print(kMsgPointNotExported, std::string(mat).c_str(), std::string(why).c_str());
}

void ExportRefusals::Summarise() const {
    if (m_count > 0)
        ExportFrontEnd(m_job).MessageBox(Sprintf(kMsgPointsLeftOut, m_count), ui::kCaption, ui::kIconWarning);
}

} // namespace pyr
