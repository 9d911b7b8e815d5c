#pragma once

// Every text the parameter store shows to a person, as printf formats. The texts are the program's own
// and are kept word for word, the slip in "imposssible" included: users and their support know them.
#include <string>

namespace pyr {

// Registry form: %s is the key path, the code is the system's.
inline constexpr char kMsgRegistryBadRoot[] = "Code incorrect pour la clef d'accès aux registres !";
inline constexpr char kMsgRegistryNoKeyName[] = "Le nom de la clef de registre à ouvrir doit être indiqué !";
inline constexpr char kMsgRegistryOpenFailed[] =
    "%s : \naccès à la clef dans la base de registre impossible (code %d) !";
// The first %s is the parameter key, the second the key path.
inline constexpr char kMsgRegistryReadFailed[] =
    "Impossible de lire le paramètre '%s' dans la clef\n%s !\n(Code d'erreur %d)";
inline constexpr char kMsgRegistryCreateFailed[] =
    "%s : \nimpossible de créer la clef dans la base de registres !\n(Code d'erreur %d) !";
inline constexpr char kMsgRegistryWriteFailed[] =
    "Impossible d'enregistrer le paramètre '%s' dans la clef\n%s !\n(Code d'erreur %d)";

// File form: %s is the file name, the code is errno.
inline constexpr char kMsgParamFileNullName[] =
    "Pointeur nul pour le fichier de paramètres !\n(Code d'erreur %d)";
inline constexpr char kMsgParamFileNoName[] =
    "Pas de nom pour le fichier de paramètres !\n(Code d'erreur %d)";
inline constexpr char kMsgParamFileSaveFailed[] =
    "%s :\nSauvegarde des paramètres imposssible !\n(Code d'erreur %d)";
inline constexpr char kMsgParamFileMissing[] = "%s :\nFichier de paramètres inexistant !\n(Code d'erreur %d)";

// The reason of a failure in words, a last line after each message of a write that failed:
// "Cause : accès refusé."
inline constexpr char kMsgFailureCause[] = "\nCause : %s.";
// The cause of a value refused because it has no name.
inline constexpr char kCauseNoKeyName[] = "paramètre sans nom";

// A parameter file (or a registry hive file) that is not text: %s is its name; for the move, then the
// name it was moved to.
inline constexpr char kMsgParamFileNotText[] =
    "%s :\nFichier de paramètres illisible (ce n'est pas un fichier texte) !\n"
    "Les paramètres par défaut sont utilisés ; le fichier sera mis de côté tel quel au premier "
    "enregistrement des paramètres.";
inline constexpr char kMsgParamFileSetAside[] =
    "%s :\nFichier de paramètres illisible (ce n'est pas un fichier texte) !\n"
    "Il a été mis de côté tel quel sous le nom\n%s\net un nouveau fichier de paramètres est créé.";

} // namespace pyr
