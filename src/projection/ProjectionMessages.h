#pragma once

// The texts of the projection library and of the change of projection of a GéoBase. Those with %s or
// %d are printf formats; the first %s is always the name as the surveyor wrote it.
namespace pyr::msg {

inline constexpr const char* kProjectionUnknown = "Projection <%s> inconnue !";
inline constexpr const char* kProjectionUtmHemisphere =
    "Projection <%s> inconnue : précisez l'hémisphère de la zone UTM (par exemple « UTM 31N » ou « UTM 40S "
    "») !";
inline constexpr const char* kProjectionUtmZone = "Projection <%s> inconnue : les zones UTM vont de 1 à 60 !";
inline constexpr const char* kProjectionEpsgUnknown = "Projection <%s> : le code EPSG:%d est inconnu !";
inline constexpr const char* kProjectionNotProjected =
    "Projection <%s> : le système EPSG:%d n'est pas une projection (ses coordonnées ne sont pas planes) !";
inline constexpr const char* kProjectionUnusable = "Projection <%s> : le système EPSG:%d ne peut pas servir "
                                                   "aux calculs (sa projection n'est pas connue de PROJ) !";
inline constexpr const char* kProjectionNoDatabase =
    "Projection <%s> : la base des systèmes de coordonnées (proj.db) est introuvable !";

// The change of projection of a GéoBase
inline constexpr const char* kChangeRefused = "Changement de projection impossible :\n%s";
inline constexpr const char* kChangeNeedsProjections =
    "Changement de projection impossible : indiquez une projection de départ et une projection d'arrivée "
    "(« Aucune » désigne des coordonnées locales, qui ne se convertissent pas) !";
inline constexpr const char* kChangePointFailed =
    "Changement de projection impossible : le point <%s> ne peut pas être converti de <%s> en <%s>.\n"
    "Aucune coordonnée de la GéoBase n'a été modifiée.";

} // namespace pyr::msg
