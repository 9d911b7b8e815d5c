#pragma once

#include "core/SafeFile.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

// What the export of a GéoBase hands the writer of a file format, and what every writer shares: which
// points go out, how the file is written, and how a point that the format cannot hold is told.
namespace pyr {

class CCarnet;
class CParamFile;
class CPyrTxtWnd;
namespace ui {
class FrontEnd;
}

// A reference of the editor's selection: a point is referred to by its element index, any other element
// (station, sighting, reading, command ...) by its index plus kObservationReference.
inline constexpr int kObservationReference = 10000000;

// The identifier range of an export ("du matricule ... au matricule ..."): the identifiers that have
// exactly the text prefix of both bounds and a number between theirs, bounds included ("A007" is in "A1"
// to "A9"). Bounds without a number, or of two prefixes, make no range.
class IdentifierRange {
public:
    // Nothing when the range cannot be made; `why` then receives the French reason.
    static std::optional<IdentifierRange> Make(std::string_view from, std::string_view to,
                                               std::string* why = nullptr);
    bool Contains(std::string_view mat) const;

    const std::string& Prefix() const { return m_prefix; }
    long long First() const { return m_first; }
    long long Last() const { return m_last; }

private:
    std::string m_prefix;
    long long m_first = 0;
    long long m_last = 0;
};

// One export to a file, as the export dialog hands it to the writer of its format.
struct PointExportJob {
    const CCarnet* carnet = nullptr;
    std::string paramFile;                       // the format's settings file; "" for a format without
    const std::vector<int>* selection = nullptr; // scope "selected": its references; null otherwise
    std::optional<IdentifierRange> range;        // scope "range"; nothing otherwise
    std::string path;                            // the file to write
    bool append = false;                         // mode "a": the file's present contents stay first
    ui::FrontEnd* parent = nullptr;              // message boxes; null: the application's front end
    CPyrTxtWnd* txt = nullptr;                   // lines about points left out; may be null
};

// The points (kind 1006) that the job writes, as element indexes in the GéoBase's order: all of them,
// those of the selection, or those of the range; none merged, sorted or dropped.
std::vector<int> ExportedPoints(const PointExportJob& job);
// For each element of the GéoBase (any kind), whether it is in the job's scope: referred to by the
// selection (as a point when it is one, else as an observation element) and its identifier in the range.
std::vector<bool> ElementsInScope(const PointExportJob& job);

// The file of an export written as it is made, a megabyte at a time, so that a million points never
// stand whole in memory: the writer appends its records to Text() and calls Flush() after each. The file
// is replaced, or with `append` completed, whole or not at all, at Commit.
class ExportFile {
public:
    explicit ExportFile(const PointExportJob& job);
    std::string& Text() { return m_text; }
    // Writes what was made once it reaches a chunk.
    void Flush() {
        if (m_text.size() >= kChunk) Drain();
    }
    // Writes what was made now.
    void Drain();
    // Writes bytes made elsewhere, after what was made here.
    void Write(std::string_view bytes);
    // Sees every piece written, in order (a checksum of the records).
    std::function<void(std::string_view)> watch;
    // Writes the rest and puts the file in place. False when it cannot: the message, naming the file and
    // the reason, is shown on the job's front end, and the file is left as it was.
    bool Commit();

private:
    static constexpr std::size_t kChunk = std::size_t{1} << 20;
    const PointExportJob& m_job;
    SafeFileWriter m_writer;
    std::string m_text;
};

// The front end on which the job's messages are shown.
ui::FrontEnd& ExportFrontEnd(const PointExportJob& job);

// The settings file of a format, checked before anything is written: false, with the message naming it
// shown, when it does not exist or cannot be read.
bool CheckExportSettingsFile(const PointExportJob& job);
// The value of a key of section "Exportation" of a settings file, trimmed; its default when the key is
// absent or empty.
std::string ExportSetting(const CParamFile& file, const char* key, const char* defaultValue);
// A value of the settings file that cannot be used: "Fichier de paramètres d'export <%s> :\nvaleur « %s »
// incorrecte pour %s (valeurs possibles : %s) !" shown on the job's front end.
void ReportBadExportSetting(const PointExportJob& job, std::string_view key, std::string_view value,
                            std::string_view allowed);

// The points that a format cannot hold (an identifier longer than its field, a coordinate too large for
// it): each one said in the text window, "Point <P12> non exporté : <reason>.", and at the end one message
// box counts them. They are left out, never cut or rounded into something else.
class ExportRefusals {
public:
    explicit ExportRefusals(const PointExportJob& job) : m_job(job) {}
    void Refuse(std::string_view mat, std::string_view why);
    int Count() const { return m_count; }
    // The message box, when points were left out.
    void Summarise() const;

private:
    const PointExportJob& m_job;
    int m_count = 0;
};

namespace fb {
// The section of the settings files of the point formats, and the line end they all choose.
inline constexpr const char* kExportSection = "Exportation";
inline constexpr const char* kKeyFinDeLigne = "FinDeLigne"; // CRLF or LF

// The reasons of ExportRefusals.
inline constexpr const char* kWhyIdentifierTooLong = "matricule de plus de %d caractères";
inline constexpr const char* kWhyCoordinateTooLarge = "%s trop grand pour le format (%s)";
inline constexpr const char* kWhyNoIdentifier = "point sans matricule";
inline constexpr const char* kWhyCodeTooLong = "code de plus de %d caractères";
inline constexpr const char* kWhyNoPosition = "point sans coordonnées";
} // namespace fb

} // namespace pyr
