#pragma once

// The French texts of the options sheet and of its command line, in one place.
namespace pyr {

inline constexpr const char* kOptionSheetCaption = "PYRALIS Calculs Topo. - Options des calculs";

// The command line of the sheet.
inline constexpr const char* kOptShowName = "afficher";
inline constexpr const char* kOptShowHelp = "affiche toutes les options, section par section";
inline constexpr const char* kOptSetName = "regler";
inline constexpr const char* kOptSetValue = "SECTION/CLÉ=VALEUR";
inline constexpr const char* kOptSetHelp = "règle une option et l'enregistre";

// Refusals of a setting (section, key, value, limits...).
inline constexpr const char* kMsgSettingMalformed = "« %s » : réglage mal écrit, il faut Section/Clé=valeur "
                                                    "(par exemple Options_Corrections/RayonTerre=6378).";
inline constexpr const char* kMsgUnknownSection = "%s : section d'options inconnue.";
inline constexpr const char* kMsgUnknownKey = "%s/%s : clé inconnue dans cette section.";
inline constexpr const char* kMsgOutOfLimits = "%s/%s : la valeur %s est hors des limites (%s à %s).";
inline constexpr const char* kMsgNotANumber = "%s/%s : la valeur « %s » n'est pas un nombre.";
inline constexpr const char* kMsgNotAnInteger = "%s/%s : la valeur « %s » n'est pas un nombre entier.";
inline constexpr const char* kMsgNotASwitch = "%s/%s : la valeur « %s » doit être 0 ou 1.";
inline constexpr const char* kMsgNoInstrument =
    "%s/%s : pas d'appareil n°%d (les appareils de la liste vont de 0 à %d).";
inline constexpr const char* kMsgNextInstrumentNumber =
    "%s/%s : un nouvel appareil prend le numéro %d, celui qui suit le dernier de la liste.";
inline constexpr const char* kMsgNewInstrumentName =
    "%s/%s : un nouvel appareil se déclare d'abord par son nom, Appareil%d.";
inline constexpr const char* kMsgEmptyInstrumentName = "%s/%s : un appareil doit avoir un nom.";
inline constexpr const char* kMsgStandardInstrument = "%s/%s : l'appareil n°0 reste « %s ».";

// What the text window says of a setting written.
inline constexpr const char* kMsgSettingWritten = "Option réglée : %s/%s=%s";

} // namespace pyr
