#pragma once

#include "fieldbook/PointExport.h"

#include <string>

// The export of a GéoBase's points to a DXF drawing (release 12): each point a POINT at its X, Y, Z,
// with its identifier, and as the settings say its altitude and its code, written beside it as TEXT;
// the points on one layer, or on one layer per code. docs/format-dxf.md describes it for a surveyor.
namespace pyr {

namespace ui {
class FrontEnd;
}

// The settings of the export, as the section "Exportation" of its settings file holds them (key names
// in comments).
struct DxfExportSettings {
    bool layersByCode = true;         // CalquesParCode: one layer per code (else every point on NomCalque)
    std::string layerName = "POINTS"; // NomCalque: the layer of every point, or of those without a code
    int layerColour = 7;              // CouleurCalque: colour of NomCalque (1 to 255)
    bool colourByCode = true;         // CouleursParCode: the layers of the codes in colours of their own
    bool textLayers = false;          // CalquesTextes: texts on layers of their own (_MAT, _ALT, _COD)
    bool writeIdentifier = true;      // EcrireMatricule
    bool writeAltitude = true;        // EcrireAltitude
    bool writeCode = false;           // EcrireCode
    double textHeight = 0.5;          // HauteurTexte, metres
    double textOffsetX = 0.3;         // DecalageTexteX, metres along the text's baseline
    double textOffsetY = 0.1;         // DecalageTexteY, metres across it, upward
    double textRotationGrads = 0.0;   // RotationTexte: counterclockwise from the X axis, grads
    int altitudeDecimals = 3;         // DecimalesZ: decimals of the altitude text
    int pointMode = 3;                // TypePoint: how a point is drawn (0 a dot, 2 a cross, 3 an X ...)
    double pointSize = 0.2;           // TaillePoint: metres; negative, % of the screen; 0, 5 % of it

    bool operator==(const DxfExportSettings&) const = default;
};

// The DXF settings dialog: its settings, read from and saved to the settings file, and the export.
class CDlgConfigDxf {
public:
    static constexpr const char* kSection = fb::kExportSection;

    DxfExportSettings& Settings() { return m_settings; }
    const DxfExportSettings& Settings() const { return m_settings; }

    // Reads the job's settings file (job.paramFile): false, with the message shown on the job's front
    // end, when it is missing or unreadable or when one of its values cannot be used; the settings are
    // then left as they were. An absent key, or one without a value, takes its default.
    bool Load(const PointExportJob& job);
    bool Load(const std::string& paramFile, ui::FrontEnd* parent = nullptr);
    // Writes every setting to the file (the other lines and comments stay). False when a value could
    // not be written: the parameter store has shown why.
    bool Save(const std::string& paramFile) const;

    // Writes the job's points with these settings, replacing the file whole (a drawing is never
    // appended to: job.append is not looked at). A point without X or Y cannot be drawn and is told
    // through ExportRefusals; a point without Z is drawn at Z 0, without altitude text. Nothing is
    // written when no point can be drawn. False when nothing is written.
    bool Write(const PointExportJob& job) const;
    // Load, then Write: what the export dialog calls.
    static bool Export(const PointExportJob& job);

private:
    DxfExportSettings m_settings;
};

namespace fb {
inline constexpr const char* kWhyNoPlanimetry = "point sans coordonnées X, Y, il ne peut pas être dessiné";
inline constexpr const char* kMsgNoPointToDraw =
    "Aucun point à dessiner : le fichier DXF <%s> n'est pas écrit.";
} // namespace fb

} // namespace pyr
