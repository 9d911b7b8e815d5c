#include "fieldbook/ExportSokkia.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "fieldbook/FieldBookUnits.h"
#include "geobase/Carnet.h"
#include "settings/ParamStore.h"

#include <filesystem>

namespace pyr {

namespace {

constexpr char kSTX = '\x02';
constexpr char kETX = '\x03';
constexpr unsigned kChecksumModulo = 65536;

// The version that heads the header record (columns 5 to 20), which names the variant.
constexpr std::string_view kVersionSdr33 = "SDR33 V04-04.02";
constexpr std::string_view kVersionSdr2x = "SDR20";
// Columns 25 to 40: the date, written blank as a transfer does when it does not give it.
constexpr std::string_view kNoDate = "00-000-00 00:00 ";

bool IsDigits(std::string_view text) {
    for (char c : text)
        if (c < '0' || c > '9') return false;
    return true;
}

class SdrWriter {
public:
    SdrWriter(const sdr::ExportSettings& settings, std::string& out)
        : m_settings(settings), m_out(out), m_eol(settings.crlf ? "\r\n" : "\n"),
          m_idWidth(settings.sdr33 ? 16 : 4), m_realWidth(settings.sdr33 ? 16 : 10),
          m_scale(settings.feet ? 1.0 / kMetresPerFoot : 1.0) {}

    std::size_t RecordLength() const { return 4 + m_idWidth + 3 * m_realWidth + sdr::kDescriptionWidth; }
    std::string_view Eol() const { return m_eol; }

    // Record 00: the version, the date, then the options: angles in grads (none written), the unit of the
    // distances, pressure and temperature in their first units, the coordinate order.
    void AppendHeader() {
        const std::string_view version = m_settings.sdr33 ? kVersionSdr33 : kVersionSdr2x;
        m_out += "00NM";
        m_out += version;
        m_out.append(16 - version.size() + 4, ' ');
        m_out += kNoDate;
        m_out += '2';
        m_out += m_settings.feet ? '2' : '1';
        m_out += "11";
        m_out += m_settings.northFirst ? '1' : '2';
        m_out += '1';
        m_out += m_eol;
    }

    // Record 08 of the point, or `out` left as it was and the reason it cannot be written.
    bool AppendPoint(const CPointGen& point, std::string& why) {
        const std::string& mat = point.mat();
        const std::string& code = point.sym();
        if (mat.empty()) return Refuse(why, fb::kWhyNoIdentifier);
        const int idLength = m_settings.sdr33 ? sdr::kSdr33IdLength : sdr::kSdr2xIdLength;
        const std::size_t idChars = Utf8Length(mat);
        if (idChars > static_cast<std::size_t>(idLength))
            return Refuse(why, Sprintf(fb::kWhyIdentifierTooLong, idLength));
        if (!m_settings.sdr33 && !IsDigits(mat)) return Refuse(why, sdr::kWhyIdNotNumeric);
        if (!point.isOk()) return Refuse(why, fb::kWhyNoPosition);
        const bool withCode = m_settings.code && !code.empty();
        const std::size_t codeChars = withCode ? Utf8Length(code) : 0;
        if (codeChars > static_cast<std::size_t>(sdr::kDescriptionWidth))
            return Refuse(why, Sprintf(fb::kWhyCodeTooLong, sdr::kDescriptionWidth));

        const std::size_t start = m_out.size();
        m_out += "08KI";
        // Identifiers right-justified, as the collectors write them; SDR2x fills its four columns with
        // zeros in front.
        m_out.append(m_idWidth - idChars, m_settings.sdr33 ? ' ' : '0');
        m_out += mat;
        const double first = m_settings.northFirst ? point.y() : point.x();
        const double second = m_settings.northFirst ? point.x() : point.y();
        const char* large = nullptr;
        if (!AppendReal(first, point.hasXY()))
            large = m_settings.northFirst ? "Y" : "X";
        else if (!AppendReal(second, point.hasXY()))
            large = m_settings.northFirst ? "X" : "Y";
        else if (!AppendReal(point.z(), point.hasZ()))
            large = "Z";
        if (large) {
            m_out.resize(start);
            return Refuse(
                why, Sprintf(fb::kWhyCoordinateTooLarge, large,
                             Sprintf("%s : %zu caractères avec %d décimales",
                                     m_settings.sdr33 ? "SDR33" : "SDR2x", m_realWidth, m_settings.decimals)
                                 .c_str()));
        }
        if (withCode) m_out += code;
        m_out.append(static_cast<std::size_t>(sdr::kDescriptionWidth) - codeChars, ' ');
        m_out += m_eol;
        return true;
    }

private:
    static bool Refuse(std::string& why, std::string text) {
        why = std::move(text);
        return false;
    }

    // A real left-justified in its field and padded with blanks; a field of blanks when there is none.
    // False when its digits pass the field.
    bool AppendReal(double metres, bool known) {
        const std::size_t start = m_out.size();
        if (known) AppendFixedShown(m_out, metres * m_scale, m_settings.decimals);
        const std::size_t length = m_out.size() - start;
        if (length > m_realWidth) return false;
        m_out.append(m_realWidth - length, ' ');
        return true;
    }

    const sdr::ExportSettings& m_settings;
    std::string& m_out;
    std::string_view m_eol;
    std::size_t m_idWidth;
    std::size_t m_realWidth;
    double m_scale;
};

// The checksum that closes a framed transfer: the sum of the bytes of the records between STX and ETX,
// their line ends included, modulo 65536.
unsigned Checksum(std::string_view records) {
    unsigned sum = 0;
    for (char c : records)
        sum = (sum + static_cast<unsigned char>(c)) % kChecksumModulo;
    return sum;
}

bool FileHoldsData(const std::string& path) {
    std::error_code error;
    const auto size = std::filesystem::file_size(path, error);
    return !error && size > 0;
}

} // namespace

std::optional<sdr::ExportSettings> sdr::ReadExportSettings(const PointExportJob& job) {
    const CParamFile file(job.paramFile);
    ExportSettings settings;
    const auto choose = [&](const char* key, const char* defaultValue, std::string_view yes,
                            std::string_view no, const char* allowed, bool& on) {
        const std::string value = ExportSetting(file, key, defaultValue);
        if (!EqualIgnoringCase(value, yes) && !EqualIgnoringCase(value, no)) {
            ReportBadExportSetting(job, key, value, allowed);
            return false;
        }
        on = EqualIgnoringCase(value, yes);
        return true;
    };
    if (!choose(kKeyFormat, "SDR33", "SDR33", "SDR2x", "SDR33, SDR2x", settings.sdr33) ||
        !choose(kKeyUniteDistances, "metres", "pieds", "metres", "metres, pieds", settings.feet) ||
        !choose(kKeyOrdreCoordonnees, "YX", "YX", "XY", "YX (N-E-Z), XY (E-N-Z)", settings.northFirst))
        return std::nullopt;

    const std::string decimals = ExportSetting(file, kKeyDecimales, "4");
    if (decimals.size() != 1 || decimals[0] < '0' || decimals[0] > '0' + kMaxExportDecimals) {
        ReportBadExportSetting(job, kKeyDecimales, decimals, "0 à 8");
        return std::nullopt;
    }
    settings.decimals = decimals[0] - '0';

    if (!choose(kKeyCode, "1", "1", "0", "0, 1", settings.code) ||
        !choose(kKeyEncadrement, "0", "1", "0", "0, 1", settings.framed) ||
        !choose(fb::kKeyFinDeLigne, "CRLF", "CRLF", "LF", "CRLF, LF", settings.crlf))
        return std::nullopt;
    return settings;
}

bool DlgCfgSok::Export(const PointExportJob& job) {
    if (!CheckExportSettingsFile(job)) return false;
    const std::optional<sdr::ExportSettings> settings = sdr::ReadExportSettings(job);
    if (!settings) return false;

    const CCarnet& carnet = *job.carnet;
    const std::vector<int> points = ExportedPoints(job);
    ExportFile file(job);
    std::string& text = file.Text();
    SdrWriter writer(*settings, text);
    unsigned sum = 0;
    if (settings->framed) {
        text += kSTX;
        text += writer.Eol();
        // The checksum counts the records, between the two framing lines.
        file.Drain();
        file.watch = [&sum](std::string_view records) { sum = (sum + Checksum(records)) % kChecksumModulo; };
    }
    // The header heads a new or empty file only: the records of a completed file follow its own.
    if (!job.append || !FileHoldsData(job.path)) writer.AppendHeader();
    ExportRefusals refusals(job);
    std::string why;
    for (int index : points) {
        const auto& point = static_cast<const CPointGen&>(*carnet.GetAt(index));
        if (!writer.AppendPoint(point, why)) refusals.Refuse(point.mat(), why);
        file.Flush();
    }
    if (settings->framed) {
        file.Drain();
        file.watch = nullptr;
        text += kETX;
        text += Sprintf("%05u", sum);
        text += writer.Eol();
    }
    if (!file.Commit()) return false;
    refusals.Summarise();
    return true;
}

} // namespace pyr
