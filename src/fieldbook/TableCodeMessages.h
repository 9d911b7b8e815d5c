#pragma once

// The texts that loading a code table writes in the text window. Those with %s or %d are printf
// formats.
namespace pyr::msg {

inline constexpr const char* kCodeTableCannotRead = "Impossible de lire la table de codes <%s> !\n(%s)";
inline constexpr const char* kCodeTableHeading = "Table de codes <%s> :";
inline constexpr const char* kCodeTableLineError = "Erreur ligne %d : %s";

// Reasons a line of a code table cannot be read
inline constexpr const char* kCodeWithoutCommand = "commande manquante pour le code <%s> !";
inline constexpr const char* kUnknownCommand = "commande <%s> inconnue pour le code <%s> !";
inline constexpr const char* kCodeDefinedTwice = "code <%s> déjà défini ligne %d !";
inline constexpr const char* kSeparatorDefinedTwice = "séparateur déjà défini ligne %d !";
inline constexpr const char* kSeparatorMissing = "valeur du séparateur manquante !";

} // namespace pyr::msg
