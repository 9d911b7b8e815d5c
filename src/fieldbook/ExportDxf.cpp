#include "fieldbook/ExportDxf.h"

#include "core/Angles.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "fieldbook/DxfWriter.h"
#include "geobase/Carnet.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"

#include <array>
#include <cmath>
#include <optional>
#include <unordered_map>

namespace pyr {

namespace {

// The keys of the settings file, section "Exportation".
inline constexpr const char* kKeyLayersByCode = "CalquesParCode";
inline constexpr const char* kKeyLayerName = "NomCalque";
inline constexpr const char* kKeyLayerColour = "CouleurCalque";
inline constexpr const char* kKeyColourByCode = "CouleursParCode";
inline constexpr const char* kKeyTextLayers = "CalquesTextes";
inline constexpr const char* kKeyWriteIdentifier = "EcrireMatricule";
inline constexpr const char* kKeyWriteAltitude = "EcrireAltitude";
inline constexpr const char* kKeyWriteCode = "EcrireCode";
inline constexpr const char* kKeyTextHeight = "HauteurTexte";
inline constexpr const char* kKeyTextOffsetX = "DecalageTexteX";
inline constexpr const char* kKeyTextOffsetY = "DecalageTexteY";
inline constexpr const char* kKeyTextRotation = "RotationTexte";
inline constexpr const char* kKeyAltitudeDecimals = "DecimalesZ";
inline constexpr const char* kKeyPointMode = "TypePoint";
inline constexpr const char* kKeyPointSize = "TaillePoint";

// What a key accepts, as the message on a wrong value says it.
inline constexpr const char* kAllowedSwitch = "0 ou 1";
inline constexpr const char* kAllowedColour = "un entier de 1 à 255";
inline constexpr const char* kAllowedHeight = "un nombre de mètres plus grand que 0, jusqu'à 100";
inline constexpr const char* kAllowedOffset = "un nombre de mètres de -1000 à 1000";
inline constexpr const char* kAllowedRotation = "un angle en grades de -400 à 400";
inline constexpr const char* kAllowedDecimals = "un entier de 0 à 6";
inline constexpr const char* kAllowedPointMode = "0 à 4, 32 à 36, 64 à 68 ou 96 à 100";
inline constexpr const char* kAllowedPointSize = "un nombre de -100 à 100";

inline constexpr double kMaxTextHeight = 100.0;
inline constexpr double kMaxOffset = 1000.0;
inline constexpr int kMaxAltitudeDecimals = 6;
// The lines of texts beside a point are this many text heights apart.
inline constexpr double kLineSpacing = 1.5;
// The suffixes of the text layers, added to the layer of the point.
inline constexpr std::string_view kIdentifierSuffix = "_MAT";
inline constexpr std::string_view kAltitudeSuffix = "_ALT";
inline constexpr std::string_view kCodeSuffix = "_COD";
// The colours given to the layers of the codes in turn, well apart from one another and readable on a
// light or a dark background.
constexpr std::array<int, 12> kCodeColours = {1, 3, 5, 6, 4, 30, 140, 210, 2, 94, 180, 8};

bool IsPointMode(int mode) {
    return mode >= 0 && mode <= 100 && mode % 32 <= 4;
}

// Reads the keys one after the other; the first value that cannot be used is told and ends the reading.
class SettingsReader {
public:
    explicit SettingsReader(const PointExportJob& job) : m_job(job), m_file(job.paramFile) {}

    bool Ok() const { return m_ok; }

    void Switch(const char* key, bool& value) {
        const auto text = Value(key);
        if (!text) return;
        if (*text == "0" || *text == "1")
            value = *text == "1";
        else
            Refuse(key, *text, kAllowedSwitch);
    }
    void Int(const char* key, int& value, int minimum, int maximum, const char* allowed) {
        const auto text = Value(key);
        if (!text) return;
        long long number = 0;
        if (ParseInt(*text, number) && number >= minimum && number <= maximum)
            value = static_cast<int>(number);
        else
            Refuse(key, *text, allowed);
    }
    void Real(const char* key, double& value, double minimum, double maximum, const char* allowed,
              bool zeroAllowed = true) {
        const auto text = Value(key);
        if (!text) return;
        // A decimal comma, as a French keyboard types it, reads as the point.
        std::string dotted = *text;
        for (char& c : dotted)
            if (c == ',') c = '.';
        double number = 0.0;
        if (ParseDouble(dotted, number) && std::isfinite(number) && number >= minimum && number <= maximum &&
            (zeroAllowed || number != 0.0))
            value = number;
        else
            Refuse(key, *text, allowed);
    }
    void Text(const char* key, std::string& value) {
        if (const auto text = Value(key)) value = *text;
    }

private:
    // The trimmed value of the key; nothing when the key is absent or empty (its default then holds) or
    // once a value has been refused.
    std::optional<std::string> Value(const char* key) {
        if (!m_ok) return std::nullopt;
        std::string text;
        m_file.ReadString(CDlgConfigDxf::kSection, key, "", text);
        const std::string_view trimmed = Trimmed(text);
        if (trimmed.empty()) return std::nullopt;
        return std::string(trimmed);
    }
    void Refuse(const char* key, const std::string& text, const char* allowed) {
        ReportBadExportSetting(m_job, key, text, allowed);
        m_ok = false;
    }

    const PointExportJob& m_job;
    CParamFile m_file;
    bool m_ok = true;
};

// The layers of one point and of its texts.
struct PointLayers {
    int point = 0;
    int identifier = 0;
    int altitude = 0;
    int code = 0;
};

// The layers of the points, by code, each made in the drawing when a point first needs it.
class LayerChoice {
public:
    LayerChoice(const DxfExportSettings& settings, dxf::DxfWriter& writer)
        : m_settings(settings), m_writer(writer),
          m_default(Make(settings.layerName.empty() ? "0" : settings.layerName, settings.layerColour)) {}

    const PointLayers& For(const std::string& code) {
        if (!m_settings.layersByCode || code.empty()) return m_default;
        if (m_lastCode && *m_lastCode == code) return *m_last;
        auto found = m_byCode.find(code);
        if (found == m_byCode.end()) {
            const int colour = m_settings.colourByCode ? kCodeColours[m_codeLayers % kCodeColours.size()]
                                                       : m_settings.layerColour;
            const int before = m_writer.LayerCount();
            const PointLayers layers = Make(code, colour);
            // A code whose name another code already gave shares that layer, and takes no new colour.
            if (m_writer.LayerCount() > before) ++m_codeLayers;
            found = m_byCode.emplace(code, layers).first;
        }
        m_lastCode = &found->first;
        m_last = &found->second;
        return found->second;
    }

private:
    PointLayers Make(std::string_view name, int colour) {
        PointLayers layers;
        layers.point = m_writer.Layer(name, colour);
        if (!m_settings.textLayers) {
            layers.identifier = layers.altitude = layers.code = layers.point;
            return layers;
        }
        // The name of the point's layer, cut so that the suffix fits in a layer name.
        std::string base = m_writer.LayerName(layers.point);
        base.resize(std::min(base.size(), dxf::kMaxNameLength - kIdentifierSuffix.size()));
        layers.identifier = m_writer.Layer(base + std::string(kIdentifierSuffix), colour);
        layers.altitude = m_writer.Layer(base + std::string(kAltitudeSuffix), colour);
        layers.code = m_writer.Layer(base + std::string(kCodeSuffix), colour);
        return layers;
    }

    const DxfExportSettings& m_settings;
    dxf::DxfWriter& m_writer;
    PointLayers m_default;
    std::unordered_map<std::string, PointLayers> m_byCode;
    const std::string* m_lastCode = nullptr;
    const PointLayers* m_last = nullptr;
    std::size_t m_codeLayers = 0;
};

} // namespace

bool CDlgConfigDxf::Load(const PointExportJob& job) {
    if (!CheckExportSettingsFile(job)) return false;
    DxfExportSettings read;
    SettingsReader reader(job);
    reader.Switch(kKeyLayersByCode, read.layersByCode);
    reader.Text(kKeyLayerName, read.layerName);
    reader.Int(kKeyLayerColour, read.layerColour, 1, 255, kAllowedColour);
    reader.Switch(kKeyColourByCode, read.colourByCode);
    reader.Switch(kKeyTextLayers, read.textLayers);
    reader.Switch(kKeyWriteIdentifier, read.writeIdentifier);
    reader.Switch(kKeyWriteAltitude, read.writeAltitude);
    reader.Switch(kKeyWriteCode, read.writeCode);
    reader.Real(kKeyTextHeight, read.textHeight, 0.0, kMaxTextHeight, kAllowedHeight, false);
    reader.Real(kKeyTextOffsetX, read.textOffsetX, -kMaxOffset, kMaxOffset, kAllowedOffset);
    reader.Real(kKeyTextOffsetY, read.textOffsetY, -kMaxOffset, kMaxOffset, kAllowedOffset);
    reader.Real(kKeyTextRotation, read.textRotationGrads, -400.0, 400.0, kAllowedRotation);
    reader.Int(kKeyAltitudeDecimals, read.altitudeDecimals, 0, kMaxAltitudeDecimals, kAllowedDecimals);
    reader.Int(kKeyPointMode, read.pointMode, 0, 100, kAllowedPointMode);
    if (reader.Ok() && !IsPointMode(read.pointMode)) {
        ReportBadExportSetting(job, kKeyPointMode, std::to_string(read.pointMode), kAllowedPointMode);
        return false;
    }
    reader.Real(kKeyPointSize, read.pointSize, -100.0, 100.0, kAllowedPointSize);
    if (!reader.Ok()) return false;
    m_settings = std::move(read);
    return true;
}

bool CDlgConfigDxf::Load(const std::string& paramFile, ui::FrontEnd* parent) {
    PointExportJob job;
    job.paramFile = paramFile;
    job.parent = parent;
    return Load(job);
}

bool CDlgConfigDxf::Save(const std::string& paramFile) const {
    const CParamFile file(paramFile);
    const DxfExportSettings& s = m_settings;
    bool saved = true;
    const auto real = [&](const char* key, double value) {
        saved = file.WriteString(kSection, key, FormatShortest(value)) && saved;
    };
    const auto integer = [&](const char* key, int value) {
        saved = file.WriteInt(kSection, key, value) && saved;
    };
    integer(kKeyLayersByCode, s.layersByCode);
    saved = file.WriteString(kSection, kKeyLayerName, s.layerName) && saved;
    integer(kKeyLayerColour, s.layerColour);
    integer(kKeyColourByCode, s.colourByCode);
    integer(kKeyTextLayers, s.textLayers);
    integer(kKeyWriteIdentifier, s.writeIdentifier);
    integer(kKeyWriteAltitude, s.writeAltitude);
    integer(kKeyWriteCode, s.writeCode);
    real(kKeyTextHeight, s.textHeight);
    real(kKeyTextOffsetX, s.textOffsetX);
    real(kKeyTextOffsetY, s.textOffsetY);
    real(kKeyTextRotation, s.textRotationGrads);
    integer(kKeyAltitudeDecimals, s.altitudeDecimals);
    integer(kKeyPointMode, s.pointMode);
    real(kKeyPointSize, s.pointSize);
    return saved;
}

bool CDlgConfigDxf::Write(const PointExportJob& job) const {
    const DxfExportSettings& s = m_settings;
    const std::vector<int> points = ExportedPoints(job);
    if (points.empty()) {
        ExportFrontEnd(job).ReportFailure(Sprintf(fb::kMsgNoPointToDraw, job.path.c_str()));
        return false;
    }

    dxf::DxfWriter writer;
    writer.SetPointDisplay(s.pointMode, s.pointSize);
    LayerChoice layers(s, writer);
    ExportRefusals refusals(job);

    // The texts stand in lines beside the point, laid out along the text's direction and turned with it.
    double sine = 0.0;
    double cosine = 1.0;
    SinCosGrads(s.textRotationGrads, sine, cosine);
    const dxf::TextStyle style{.height = s.textHeight, .rotationGrads = s.textRotationGrads};
    const double lineStep = kLineSpacing * s.textHeight;
    std::string altitude;

    // Every point drawn, the points left out told when `tell`; the number drawn.
    const CCarnet& carnet = *job.carnet;
    const auto drawPoints = [&](bool tell) {
        int drawn = 0;
        for (const int index : points) {
            const auto& point = static_cast<const CPointGen&>(*carnet.GetAt(index));
            const dxf::Point3 at{point.x(), point.y(), point.hasZ() ? point.z() : 0.0};
            if (!point.hasXY() || !std::isfinite(at.x) || !std::isfinite(at.y) || !std::isfinite(at.z)) {
                if (tell) refusals.Refuse(point.mat(), fb::kWhyNoPlanimetry);
                continue;
            }
            // The layer is made for a point drawn: a code whose points are all left out makes none.
            const PointLayers& layer = layers.For(point.sym());
            writer.Point(layer.point, at);
            ++drawn;
            double across = s.textOffsetY;
            const auto text = [&](int textLayer, std::string_view words) {
                const dxf::Point3 place{at.x + s.textOffsetX * cosine - across * sine,
                                        at.y + s.textOffsetX * sine + across * cosine, at.z};
                writer.Text(textLayer, place, words, style);
                across -= lineStep;
            };
            if (s.writeIdentifier && !point.mat().empty()) text(layer.identifier, point.mat());
            if (s.writeAltitude && point.hasZ()) {
                altitude.clear();
                AppendFixedShown(altitude, point.z(), s.altitudeDecimals);
                text(layer.altitude, altitude);
            }
            if (s.writeCode && !point.sym().empty()) text(layer.code, point.sym());
            writer.Flush();
        }
        return drawn;
    };

    // Measured first, so that the header and the tables that come first give the extents and the layers
    // of everything drawn; then drawn again into the file, a megabyte at a time.
    writer.Measure();
    if (drawPoints(false) == 0) {
        drawPoints(true);
        ExportFrontEnd(job).ReportFailure(Sprintf(fb::kMsgNoPointToDraw, job.path.c_str()));
        refusals.Summarise();
        return false;
    }
    PointExportJob whole = job; // a drawing is never completed
    whole.append = false;
    ExportFile file(whole);
    writer.Stream([&file](std::string_view bytes) { file.Write(bytes); });
    drawPoints(true);
    writer.Finish();
    const bool written = file.Commit();
    refusals.Summarise();
    return written;
}

bool CDlgConfigDxf::Export(const PointExportJob& job) {
    CDlgConfigDxf dialog;
    return dialog.Load(job) && dialog.Write(job);
}

} // namespace pyr
