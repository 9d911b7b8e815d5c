#include "fieldbook/ExportLeica.h"

#include "core/Strings.h"
#include "fieldbook/FieldBookUnits.h"
#include "geobase/Carnet.h"
#include "settings/ParamStore.h"

#include <cmath>
#include <cstring>

namespace pyr {

namespace {

constexpr double kPowersOfTen[] = {1.0, 1e1,  1e2,  1e3,  1e4,  1e5,  1e6,  1e7, 1e8,
                                   1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15, 1e16};
constexpr int kBlockNumbers = 9999; // positions 3 to 6 of word 11

// The widest block written: word 11, three coordinates and a code, each word of 7 header characters, its
// data and a blank, the '*' of GSI-16 and a line end.
constexpr std::size_t kWordHeader = 7;
constexpr std::size_t LargestBlock(std::size_t width) {
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

// The block of a point is made in a buffer of the largest block's size, then appended at once: a million
// points are a million appends, not ten million.
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
        if (!point.hasXY() && !point.hasZ()) return Refuse(why, fb::kWhyNoPosition);
        const bool withCode = m_settings.code && !code.empty();
        if (withCode && code.size() > m_width) return Refuse(why, Sprintf(fb::kWhyCodeTooLong, int(m_width)));

        char* p = m_block;
        if (m_settings.gsi16) *p++ = '*';
        p = Put(p, "11");
        p = PutDigits(p, static_cast<unsigned long long>(m_number), 4);
        *p++ = '+';
        p = PutPadded(p, mat);
        const char* large = nullptr;
        if (point.hasXY()) {
            if (!(p = PutLength(p, "81", point.x())))
                large = "X";
            else if (!(p = PutLength(p, "82", point.y())))
                large = "Y";
        }
        if (!large && point.hasZ() && !(p = PutLength(p, "83", point.z()))) large = "Z";
        if (large)
            return Refuse(why, Sprintf(fb::kWhyCoordinateTooLarge, large,
                                       Sprintf("GSI-%zu en %s", m_width, UnitName(m_settings.unit)).c_str()));
        if (withCode) {
            p = Put(p, "71....+");
            p = PutPadded(p, code);
        }
        p = Put(p, m_settings.crlf ? "\r\n" : "\n");
        m_out.append(m_block, static_cast<std::size_t>(p - m_block));
        m_number = m_number % kBlockNumbers + 1;
        return true;
    }

private:
    static bool Refuse(std::string& why, std::string text) {
        why = std::move(text);
        return false;
    }

    static char* Put(char* p, std::string_view text) {
        std::memcpy(p, text.data(), text.size());
        return p + text.size();
    }

    // The number on `width` digits, zeros in front.
    static char* PutDigits(char* p, unsigned long long n, std::size_t width) {
        for (std::size_t i = width; i-- > 0; n /= 10)
            p[i] = static_cast<char>('0' + n % 10);
        return p + width;
    }

    // The data right-justified in the word, padded with zeros in front as the instruments write it, and
    // the blank that ends the word.
    char* PutPadded(char* p, std::string_view data) const {
        const std::size_t pad = m_width - data.size();
        std::memset(p, '0', pad);
        p = Put(p + pad, data);
        *p++ = ' ';
        return p;
    }

    // A length word: index, "..0" and the unit digit, the sign, the digits of the value in that unit
    // without a decimal point. Null when they do not fit in the word.
    char* PutLength(char* p, const char* index, double metres) const {
        const double value = m_feet ? metres / kMetresPerFoot : metres;
        const double scaled = std::fabs(value) * kPowersOfTen[m_decimals];
        if (!(scaled < kPowersOfTen[m_width] - 0.5)) return nullptr;
        const long long digits = std::llround(scaled);
        if (digits >= static_cast<long long>(kPowersOfTen[m_width])) return nullptr;
        p = Put(p, index);
        p = Put(p, "..0");
        *p++ = m_settings.unit;
        // A value that rounds to zero has no sign to keep.
        *p++ = value < 0 && digits != 0 ? '-' : '+';
        p = PutDigits(p, static_cast<unsigned long long>(digits), m_width);
        *p++ = ' ';
        return p;
    }

    const CDlgConfigLeica::Settings& m_settings;
    std::string& m_out;
    std::size_t m_width;
    int m_decimals;
    bool m_feet;
    int m_number = 1; // of the block, positions 3 to 6 of word 11
    char m_block[LargestBlock(16)];
};

} // namespace

std::optional<CDlgConfigLeica::Settings> CDlgConfigLeica::ReadSettings(const PointExportJob& job) {
    const CParamFile file(job.paramFile);
    Settings settings;

    const std::string format = ExportSetting(file, gsi::kKeyFormatGsi, "16");
    if (format != "8" && format != "16") {
        ReportBadExportSetting(job, gsi::kKeyFormatGsi, format, "8, 16");
        return std::nullopt;
    }
    settings.gsi16 = format == "16";

    const std::string unit = ExportSetting(file, gsi::kKeyUniteLongueurs, "0");
    if (unit.size() != 1 || std::string_view("01678").find(unit[0]) == std::string_view::npos) {
        ReportBadExportSetting(job, gsi::kKeyUniteLongueurs, unit,
                               "0 mm, 6 0,1 mm, 8 0,01 mm, 1 pied, 7 pied au dix-millième");
        return std::nullopt;
    }
    settings.unit = unit[0];

    const std::string code = ExportSetting(file, gsi::kKeyCode, "1");
    if (code != "0" && code != "1") {
        ReportBadExportSetting(job, gsi::kKeyCode, code, "0, 1");
        return std::nullopt;
    }
    settings.code = code == "1";

    const std::string lineEnd = ExportSetting(file, fb::kKeyFinDeLigne, "CRLF");
    if (!EqualIgnoringCase(lineEnd, "CRLF") && !EqualIgnoringCase(lineEnd, "LF")) {
        ReportBadExportSetting(job, fb::kKeyFinDeLigne, lineEnd, "CRLF, LF");
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
    ExportFile file(job);
    GsiWriter writer(*settings, file.Text());
    ExportRefusals refusals(job);
    std::string why;
    for (int index : points) {
        const auto& point = static_cast<const CPointGen&>(*carnet.GetAt(index));
        if (!writer.Append(point, why)) refusals.Refuse(point.mat(), why);
        file.Flush();
    }
    // A GSI file has no header: a completed file simply goes on with the new blocks.
    if (!file.Commit()) return false;
    refusals.Summarise();
    return true;
}

} // namespace pyr
