#pragma once

// The texts that the observation store shows or writes in the text window. Those with %s or %d are
// printf formats.
namespace pyr::msg {

inline constexpr const char* kNoSelection = "La liste de sélection des points n'est pas correcte !";
inline constexpr const char* kNoChange = "Aucune modification apportée à la GéoBase !";
inline constexpr const char* kSaveFailed = "Impossible d'enregistrer la GéoBase sous\n%s !";
inline constexpr const char* kSaved = "GéoBase enregistrée dans <%s>.";
inline constexpr const char* kCannotWrite = "Impossible d'écrire dans la GéoBase indiquée !";
inline constexpr const char* kCreated = "GéoBase créée = <%s>.";
inline constexpr const char* kElementDeleted = "Elément # %d (%s%s) supprimé de la GéoBase.";

// Saving: a file is replaced only by a GéoBase written whole, and only when it is a GéoBase that its owner
// left writable. Each refusal or failure follows kSaveFailed with its reason.
inline constexpr const char* kSaveFailedReason = "\n(%s).";
inline constexpr const char* kLeftAsItWas = "\nLe fichier est resté tel qu'il était.";
inline constexpr const char* kRefusedReadOnly =
    "\nCe fichier est en lecture seule : il est laissé tel qu'il est.\nEnregistrez la GéoBase sous un autre "
    "nom, ou retirez d'abord la protection du fichier.";
inline constexpr const char* kRefusedForeign =
    "\nCe fichier n'est pas une GéoBase : il est laissé tel qu'il est.\nEnregistrez la GéoBase sous un autre "
    "nom.";
inline constexpr const char* kBackUpFailed =
    "Impossible de faire la copie de sauvegarde de la GéoBase\n%s\ndans\n%s\n(%s).\nLa GéoBase n'est pas "
    "enregistrée ; l'ancienne copie de sauvegarde, s'il y en a une, est restée telle qu'elle était.";

// Loading
inline constexpr const char* kCannotOpen = "Impossible d'ouvrir la GéoBase <%s> !\n(%s)";
inline constexpr const char* kNoHeader = "GéoBase <%s> : la première ligne n'est pas l'en-tête d'une GéoBase "
                                         "PYRALIS ; les lignes sont lues quand même.";
inline constexpr const char* kNewerVersion =
    "GéoBase <%s> : version %d du format, plus récente que celle de ce programme (%d) ; les lignes sont lues "
    "quand même.";
inline constexpr const char* kReadAsWindows1252 = "GéoBase <%s> : fichier lu en Windows-1252.";
inline constexpr const char* kLineKept = "Erreur ligne %d : %s ; la ligne est conservée en commentaire.";
inline constexpr const char* kLoaded = "GéoBase <%s> : %d éléments lus.";
inline constexpr const char* kOpenedReadOnly =
    "GéoBase <%s> en lecture seule : elle peut être lue et calculée, mais ses résultats ne pourront pas y "
    "être enregistrés.";
inline constexpr const char* kOpenedForeign =
    "<%s> n'est pas une GéoBase (%lld ligne(s) illisible(s) sur %lld) : ses lignes sont montrées en "
    "commentaires, mais ce fichier ne sera pas remplacé par un enregistrement.";

// Reasons a line cannot be read
inline constexpr const char* kUnknownKind = "type d'élément %s inconnu";
inline constexpr const char* kNoKind = "type d'élément absent";
inline constexpr const char* kMissingFields = "il manque des champs (%d lus, %d attendus)";
inline constexpr const char* kExtraFields = "champs en trop (%d lus, %d attendus au plus)";
inline constexpr const char* kBadNumber = "valeur numérique incorrecte <%s>";
inline constexpr const char* kBadFlag = "indicateur incorrect <%s>";

// Validation of elements built from outside
inline constexpr const char* kStationNoName = "Station sans nom : elle n'est pas ajoutée à la GéoBase !";
inline constexpr const char* kStationBadHI =
    "Station <%s> : hauteur d'instrument incorrecte (%s m) : elle n'est pas ajoutée à la GéoBase !";
inline constexpr const char* kStationBadV0 =
    "Station <%s> : V0 incorrect (%s gr) : elle n'est pas ajoutée à la GéoBase !";
inline constexpr const char* kSightingNoName =
    "Visée sans matricule de point : elle n'est pas ajoutée à la GéoBase !";
inline constexpr const char* kSightingNoStation =
    "Visée <%s> sans station avant elle : elle n'est pas ajoutée à la GéoBase !";
inline constexpr const char* kSightingEmpty =
    "Visée <%s> sans aucune mesure : elle n'est pas ajoutée à la GéoBase !";
inline constexpr const char* kSightingBadAH =
    "Visée <%s> : angle horizontal incorrect (%s gr) : elle n'est pas ajoutée à la GéoBase !";
inline constexpr const char* kSightingBadAV =
    "Visée <%s> : angle zénithal incorrect (%s gr, entre 0 et 400) : elle n'est pas ajoutée à la GéoBase !";
inline constexpr const char* kSightingBadDI =
    "Visée <%s> : distance incorrecte (%s m) : elle n'est pas ajoutée à la GéoBase !";
inline constexpr const char* kSightingBadHP =
    "Visée <%s> : hauteur de prisme incorrecte (%s m) : elle n'est pas ajoutée à la GéoBase !";
inline constexpr const char* kPointNoName = "Point sans matricule : il n'est pas ajouté à la GéoBase !";
inline constexpr const char* kPointHalfXY =
    "Point <%s> : X et Y doivent être donnés ensemble : il n'est pas ajouté à la GéoBase !";
inline constexpr const char* kPointEmpty = "Point <%s> sans coordonnées : il n'est pas ajouté à la GéoBase !";
inline constexpr const char* kPointBadValue =
    "Point <%s> : coordonnée incorrecte : il n'est pas ajouté à la GéoBase !";

// Editing
inline constexpr const char* kDisabled = "Elément # %d (%s <%s>) transformé en commentaire.";
inline constexpr const char* kEnabled = "Elément # %d : commentaire rétabli en %s <%s>.";
inline constexpr const char* kNotAnElementComment =
    "Elément # %d : ce commentaire ne décrit pas un élément de la GéoBase (%s) !";
inline constexpr const char* kAlreadyComment = "Elément # %d : c'est déjà un commentaire !";
inline constexpr const char* kNotAComment = "Elément # %d : ce n'est pas un commentaire !";

} // namespace pyr::msg
