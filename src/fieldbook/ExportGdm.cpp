#include "fieldbook/ExportGdm.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookUnits.h"
#include "geobase/Carnet.h"
#include "settings/ParamStore.h"

namespace pyr {

namespace {

// A label line: the label, '=', then the value appended by the caller.
void Label(std::string& out, std::string_view label) {
    out += label;
    out += '=';
}

} // namespace

std::optional<gdm::ExportSettings> gdm::ReadExportSettings(const PointExportJob& job) {
    const CParamFile file(job.paramFile);
    ExportSettings settings;

    const std::string unit = ExportSetting(file, kKeyUniteDistances, "metres");
    if (!EqualIgnoringCase(unit, "metres") && !EqualIgnoringCase(unit, "pieds")) {
        ReportBadExportSetting(job, kKeyUniteDistances, unit, "metres, pieds");
        return std::nullopt;
    }
    settings.feet = EqualIgnoringCase(unit, "pieds");

    const std::string decimals = ExportSetting(file, kKeyDecimales, "3");
    if (decimals.size() != 1 || decimals[0] < '0' || decimals[0] > '0' + kMaxExportDecimals) {
        ReportBadExportSetting(job, kKeyDecimales, decimals, "0 à 8");
        return std::nullopt;
    }
    settings.decimals = decimals[0] - '0';

    for (auto [key, on] :
         {std::pair{kKeyLabelUnites, &settings.unitLabel}, std::pair{kKeyCode, &settings.code}}) {
        const std::string value = ExportSetting(file, key, "1");
        if (value != "0" && value != "1") {
            ReportBadExportSetting(job, key, value, "0, 1");
            return std::nullopt;
        }
        *on = value == "1";
    }

    const std::string lineEnd = ExportSetting(file, fb::kKeyFinDeLigne, "CRLF");
    if (!EqualIgnoringCase(lineEnd, "CRLF") && !EqualIgnoringCase(lineEnd, "LF")) {
        ReportBadExportSetting(job, fb::kKeyFinDeLigne, lineEnd, "CRLF, LF");
        return std::nullopt;
    }
    settings.crlf = EqualIgnoringCase(lineEnd, "CRLF");
    return settings;
}

bool dll_ExportSpectra(const PointExportJob& job) {
    if (!CheckExportSettingsFile(job)) return false;
    const std::optional<gdm::ExportSettings> settings = gdm::ReadExportSettings(job);
    if (!settings) return false;
    const std::string_view eol = settings->crlf ? "\r\n" : "\n";
    const double scale = settings->feet ? 1.0 / kMetresPerFoot : 1.0;
    const int decimals = settings->decimals;

    const CCarnet& carnet = *job.carnet;
    const std::vector<int> points = ExportedPoints(job);
    ExportFile file(job);
    std::string& text = file.Text();
    // The units of the values that follow, angles in grads (none written), distances in metres or feet,
    // temperature and pressure in their first units. It heads each export, a completed file included: it
    // holds for what follows it, whatever unit the file stated before.
    if (settings->unitLabel) {
        Label(text, "23");
        text += settings->feet ? "1211" : "1111";
        text += eol;
    }
    ExportRefusals refusals(job);
    const auto coordinate = [&](std::string_view label, double metres) {
        Label(text, label);
        AppendFixedShown(text, metres * scale, decimals);
        text += eol;
    };
    for (int index : points) {
        const auto& point = static_cast<const CPointGen&>(*carnet.GetAt(index));
        if (point.mat().empty()) {
            refusals.Refuse(point.mat(), fb::kWhyNoIdentifier);
            continue;
        }
        if (!point.isOk()) {
            refusals.Refuse(point.mat(), fb::kWhyNoPosition);
            continue;
        }
        Label(text, "5");
        text += point.mat();
        text += eol;
        // The code comes after the identifier: it belongs to the block that label 5 opened.
        if (settings->code && !point.sym().empty()) {
            Label(text, "4");
            text += point.sym();
            text += eol;
        }
        if (point.hasXY()) {
            coordinate("38", point.x());
            coordinate("37", point.y());
        }
        if (point.hasZ()) coordinate("39", point.z());
        file.Flush();
    }
    if (!file.Commit()) return false;
    refusals.Summarise();
    return true;
}

} // namespace pyr
