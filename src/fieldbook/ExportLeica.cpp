#include "fieldbook/ExportLeica.h"

#include "core/Strings.h"
#include "fieldbook/FieldBookUnits.h"
#include "geobase/Carnet.h"
#include "settings/ParamStore.h"

#include <charconv>
#include <cmath>

namespace pyr {

namespace {

constexpr double kPowersOfTen[] = {1.0, 1e1,  1e2,  1e3,  1e4,  1e5,  1e6,  1e7, 1e8,
                                   1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15, 1e16};
constexpr int kBlockNumbers = 9999; // positions 3 to 6 of word 11

// The widest block written: word 11, three coordinates and a code, each word of 7 header characters, its
// data and a blank, the '*' of GSI-16 and a line end.
constexpr std::size_t kWordHeader = 7;
std::size_t LargestBlock(std::size_t width) {
    return 1 + 5 * (kWordHeader + width + 1) + 2;
}

int LengthDecimals(char unit) {
    return unit == '6' || unit == '7' ? 4 : unit == '8' ? 5 : 3;
}

bool IsFeet(char unit) {
    return unit == '1' || unit == '7';
}

// The unit as a surveyor names it, for the reason of a coordinate left out.
const char* UnitName(char unit) {
    switch (unit) {
    case '1':
        return "pied au millième";
    case '6':
        return "0,1 mm";
    case '7':
        return "pied au dix-millième";
    case '8':
        return "0,01 mm";
    default:
        return "mm";
    }
}

// Appends the data right-justified in `width` characters, padded with zeros in front as the
// instruments write it.
void AppendPadded(std::string& out, std::string_view data, std::size_t width) {
    out.append(width - data.size(), '0');
    out += data;
}

class GsiWriter {
public:
    GsiWriter(const CDlgConfigLeica::Settings& settings, std::string& out)
        : m_settings(settings), m_out(out), m_width(settings.gsi16 ? 16 : 8),
          m_decimals(LengthDecimals(settings.unit)), m_feet(IsFeet(settings.unit)) {}

    std::size_t Width() const { return m_width; }

    // Appends the block of the point, or leaves `out` as it was and returns the reason it cannot.
    bool Append(const CPointGen& point, std::string& why) {
        const std::string& mat = point.mat();
        const std::string& code = point.sym();
        if (mat.empty()) return Refuse(why, fb::kWhyNoIdentifier);
        if (mat.size() > m_width) return Refuse(why, Sprintf(fb::kWhyIdentifierTooLong, int(m_width)));
        if (!point.hasXY() && !point.hasZ()) return Refuse(why, gsi::kWhyNoPosition);
        const bool withCode = m_settings.code && !code.empty();
        if (withCode && code.size() > m_width)
            return Refuse(why, Sprintf(gsi::kWhyCodeTooLong, int(m_width)));

        const std::size_t start = m_out.size();
        if (m_settings.gsi16) m_out += '*';
        m_out += "11";
        AppendBlockNumber();
        m_out += '+';
        AppendPadded(m_out, mat, m_width);
        m_out += ' ';
        const char* large = nullptr;
        if (point.hasXY()) {
            if (!AppendLength("81", point.x()))
                large = "X";
            else if (!AppendLength("82", point.y()))
                large = "Y";
        }
        if (!large && point.hasZ() && !AppendLength("83", point.z())) large = "Z";
        if (large) {
            m_out.resize(start);
            return Refuse(why, Sprintf(fb::kWhyCoordinateTooLarge, large,
                                       Sprintf("GSI-%zu en %s", m_width, UnitName(m_settings.unit)).c_str()));
        }
        if (withCode) {
            m_out += "71....+";
            AppendPadded(m_out, code, m_width);
            m_out += ' ';
        }
        m_out += m_settings.crlf ? "\r\n" : "\n";
        m_block = m_block % kBlockNumbers + 1;
        return true;
    }

private:
    static bool Refuse(std::string& why, std::string text) {
        why = std::move(text);
        return false;
    }

    void AppendBlockNumber() {
        char digits[4] = {'0', '0', '0', '0'};
        for (int n = m_block, i = 3; n > 0 && i >= 0; n /= 10, --i)
            digits[i] = static_cast<char>('0' + n % 10);
        m_out.append(digits, 4);
    }

    // A length word: index, "..0" and the unit digit, the sign, the digits of the value in that unit
    // without a decimal point. False when they do not fit in the word.
    bool AppendLength(const char* index, double metres) {
        const double value = m_feet ? metres / kMetresPerFoot : metres;
        const double scaled = std::fabs(value) * kPowersOfTen[m_decimals];
        if (!(scaled < kPowersOfTen[m_width] - 0.5)) return false;
        const long long digits = std::llround(scaled);
        char text[24];
        const auto end = std::to_chars(text, text + sizeof text, digits).ptr;
        const auto count = static_cast<std::size_t>(end - text);
        if (count > m_width) return false;
        m_out += index;
        m_out += "..0";
        m_out += m_settings.unit;
        // A value that rounds to zero has no sign to keep.
        m_out += value < 0 && digits != 0 ? '-' : '+';
        AppendPadded(m_out, std::string_view(text, count), m_width);
        m_out += ' ';
        return true;
    }

    const CDlgConfigLeica::Settings& m_settings;
    std::string& m_out;
    std::size_t m_width;
    int m_decimals;
    bool m_feet;
    int m_block = 1;
};

// The value of a key, trimmed; its default when the key is absent or empty.
std::string Setting(const CParamFile& file, const char* key, const char* defaultValue) {
    std::string value;
    file.ReadString(gsi::kExportSection, key, defaultValue, value);
    const std::string_view trimmed = Trimmed(value);
    return trimmed.empty() ? std::string(defaultValue) : std::string(trimmed);
}

} // namespace

std::optional<CDlgConfigLeica::Settings> CDlgConfigLeica::ReadSettings(const PointExportJob& job) {
    const CParamFile file(job.paramFile);
    Settings settings;

    const std::string format = Setting(file, gsi::kKeyFormatGsi, "16");
    if (format != "8" && format != "16") {
        ReportBadExportSetting(job, gsi::kKeyFormatGsi, format, "8, 16");
        return std::nullopt;
    }
    settings.gsi16 = format == "16";

    const std::string unit = Setting(file, gsi::kKeyUniteLongueurs, "0");
    if (unit.size() != 1 || std::string_view("01678").find(unit[0]) == std::string_view::npos) {
        ReportBadExportSetting(job, gsi::kKeyUniteLongueurs, unit,
                               "0 mm, 6 0,1 mm, 8 0,01 mm, 1 pied, 7 pied au dix-millième");
        return std::nullopt;
    }
    settings.unit = unit[0];

    const std::string code = Setting(file, gsi::kKeyCode, "1");
    if (code != "0" && code != "1") {
        ReportBadExportSetting(job, gsi::kKeyCode, code, "0, 1");
        return std::nullopt;
    }
    settings.code = code == "1";

    const std::string lineEnd = Setting(file, gsi::kKeyFinDeLigne, "CRLF");
    if (!EqualIgnoringCase(lineEnd, "CRLF") && !EqualIgnoringCase(lineEnd, "LF")) {
        ReportBadExportSetting(job, gsi::kKeyFinDeLigne, lineEnd, "CRLF, LF");
        return std::nullopt;
    }
    settings.crlf = EqualIgnoringCase(lineEnd, "CRLF");
    return settings;
}

bool CDlgConfigLeica::Export(const PointExportJob& job) {
    if (!CheckExportSettingsFile(job)) return false;
    const std::optional<Settings> settings = ReadSettings(job);
    if (!settings) return false;

    const CCarnet& carnet = *job.carnet;
    const std::vector<int> points = ExportedPoints(job);
    std::string text;
    GsiWriter writer(*settings, text);
    text.reserve(points.size() * LargestBlock(writer.Width()));
    ExportRefusals refusals(job);
    std::string why;
    for (int index : points) {
        const auto& point = static_cast<const CPointGen&>(*carnet.GetAt(index));
        if (!writer.Append(point, why)) refusals.Refuse(point.mat(), why);
    }
    // A GSI file has no header: a completed file simply goes on with the new blocks.
    if (!WriteExportFile(job, text)) return false;
    refusals.Summarise();
    return true;
}

} // namespace pyr
