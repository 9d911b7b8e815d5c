#pragma once

// The words every computation dialog shares: opening its GéoBase, writing points back, leaving it.
namespace pyr::session {

inline constexpr const char* kChooseGeoBase = "Sélectionnez la GéoBase à traiter :";
inline constexpr const char* kMsgNoGeoBase = "Aucune GéoBase à traiter : indiquez-la avec --geobase.";
inline constexpr const char* kMsgEmptyGeoBase = "La GéoBase <%s> est vide : aucun calcul possible !";

inline constexpr const char* kQuestionInvariantXY =
    "Le point '%s' possède déjà des coordonnées X et Y\ndans la GéoBase. Ces coordonnées ont été déclarées\n"
    "invariantes. Voulez-vous quand même les remplacer ?";
inline constexpr const char* kQuestionInvariantZ =
    "Le point '%s' possède déjà une altitude dans\nla GéoBase. Celle-ci a été déclarée invariante.\n"
    "Voulez-vous quand même la remplacer ?";
inline constexpr const char* kQuestionStationInvariantXY =
    "La station '%s' possède déjà des coordonnées X et Y\ndans la GéoBase. Ces coordonnées ont été "
    "déclarées\ninvariantes. Voulez-vous quand même les remplacer ?";
inline constexpr const char* kQuestionStationInvariantZ =
    "La station '%s' possède déjà une altitude dans\nla GéoBase. Celle-ci a été déclarée invariante.\n"
    "Voulez-vous quand même la remplacer ?";
// A computation that failed for a reason its status line does not give.
inline constexpr const char* kMsgNotComputed = "Le point n'a pas pu être calculé !";
inline constexpr const char* kMsgWriteRefused = "Impossible de mettre à jour ou de créer le point !";
inline constexpr const char* kQuestionSaveModified =
    "La GéoBase courante a été modifiée !\nVoulez vous l'enregistrer ?";

// Lines of the text window.
inline constexpr const char* kLinePointWritten = "Point <%s> écrit dans la GéoBase.";
inline constexpr const char* kLineInvariantKept = "Point <%s> : coordonnées invariantes gardées.";

} // namespace pyr::session
