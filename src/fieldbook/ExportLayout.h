#pragma once

#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/PointExport.h"

// The points of a GéoBase written as a delimited (CDlgConfigSep) or columnar (CDlgConfigCol) field book,
// through the section "Parametrage" of the same settings file that reads them: one line per point as
// "ChampsPoint" lays it out, in the separators and the distance unit of the file, so that reading the
// export back with those settings gives the same points.
//
// Numbers: a delimited line carries every digit the GéoBase holds (the shortest text that reads back as
// the same double); a columnar number is right-aligned in its columns, with that text when it fits and
// otherwise with as many decimals as the columns leave. A value unknown in the GéoBase (a point without
// altitude) leaves its field empty. A point that the columns cannot hold (an identifier or a code longer
// than its field, a coordinate whose whole part does not fit) is left out and told, never cut.
namespace pyr {

namespace fb {
// Why a settings file cannot serve an export ("Fichier de paramétrage <%s> :\n%s incorrect : %s !").
inline constexpr const char* kWhyExportNoPointFields = "la liste est vide : aucun point ne peut s'écrire";
inline constexpr const char* kWhyExportFieldMissing =
    "le champ %s manque : les points ne peuvent pas s'écrire";
inline constexpr const char* kWhyExportFieldsOverlap = "les champs %s et %s se chevauchent";
inline constexpr const char* kWhyExportEmptyType = "le mot est vide : les points ne pourraient pas se relire";
inline constexpr const char* kWhyExportTypeTaken = "le mot « %s » est aussi celui de %s";
inline constexpr const char* kWhyExportTypeTooLong =
    "le mot « %s » ne tient pas dans les colonnes %d à %d du champ TYPE";
// Why a point is left out, besides those of PointExport.h.
inline constexpr const char* kWhyLineEndInText = "matricule ou code sur plusieurs lignes";
} // namespace fb

// Writes the points of `job` (ExportedPoints) by the layout of `job.paramFile`, read as a settings file of
// `format` (Separateur or Colonne). The header lines ("LignesEntete") go at the start of a new or empty
// file only, the last of them naming the fields. False, nothing written, when the settings file is
// missing, wrong or unfit for points, or when the file cannot be written (the message shown on the job's
// front end); true otherwise, the points left out counted in one message.
bool ExportLayoutPoints(const PointExportJob& job, FieldBookFormat format);

} // namespace pyr
