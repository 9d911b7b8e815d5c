#pragma once

#include "ui/FrontEnd.h"

#include <functional>
#include <string>
#include <string_view>

// Point identifiers (matricules): their normal form, their split into a text prefix and a trailing
// number, the next free one, and the checks of an identifier typed in a dialog. The rules are written
// for surveyors in docs/identifiants.md.
namespace pyr {

namespace msg {

inline constexpr const char* kMatMissing = "Le matricule du point doit être indiqué !";
inline constexpr const char* kMatIncorrect = "Le matricule <%s> n'est pas correct : %s !";

// Reasons why an identifier is not correct, completing kMatIncorrect.
inline constexpr const char* kMatWhyEmpty = "il est vide";
inline constexpr const char* kMatWhyBlank = "il contient un espace";
inline constexpr const char* kMatWhyControl = "il contient un caractère de contrôle";
inline constexpr const char* kMatWhyNotText = "il contient des caractères illisibles";
inline constexpr const char* kMatWhySeparator = "il contient « %s », qui sépare les points d'une sélection";
inline constexpr const char* kMatWhyLeadingDash = "il commence par un tiret";
inline constexpr const char* kMatWhyTrailingDash = "il finit par un tiret";

} // namespace msg

// The largest trailing number an identifier can carry (18 digits, leading zeros not counted). Beyond
// it the digits are text: the identifier has no number, and no range or next number applies to it.
inline constexpr long long kMaxMatNumber = 999'999'999'999'999'999;

// How many candidates NextMat tries at most before giving up.
inline constexpr long long kNextMatMaxTries = 10'000'000;

// The normal form of an identifier, as a view into the given text: blanks trimmed at both ends, leading
// zeros dropped ("0000000000000012" -> "12", "00A12" -> "A12"), one zero kept when nothing else
// remains ("000" -> "0") or when a sign other than a letter or a digit follows ("00-1" -> "0-1").
// Letter case and inner characters are kept.
std::string_view FormMatView(std::string_view id);

// The parts of a normalised identifier, as views into it.
struct MatParts {
    std::string_view prefix; // the text before the trailing digits, the whole identifier when none
    std::string_view digits; // the trailing digits as written, leading zeros included ("0012")
    long long number = -1;   // their value; -1 when there are none or more than kMaxMatNumber
};
MatParts SplitMat(std::string_view normalisedId);

// Normalises an identifier in place (see FormMatView).
void FormMat(std::string& id);

// Builds the identifier made of prefix and number, the number zero-padded to minDigits (0: as it is),
// and normalises it. A negative number means "no number": the result is the prefix alone, so that
// what ExtrMat splits builds back. A purely numeric identifier is never padded ("", 12, 4 -> "12").
std::string FormMat(std::string_view prefix, long long number, int minDigits);

// Splits the normalised identifier into its text prefix and its trailing number: "A12" -> "A", 12;
// "12" -> "", 12; "A0012" -> "A", 12; "A-5" -> "A-", 5 (numbers are never negative). Returns false,
// with prefix the whole normalised identifier and number -1, when it does not end with a digit or when
// its trailing number is larger than kMaxMatNumber.
bool ExtrMat(std::string_view id, std::string& prefix, long long& number);

// The next identifier after id that isUsed says is free (an empty isUsed: every one is free). The
// prefix and the width of the number are kept ("A09" -> "A10", "A0009" -> "A0010", "A99" -> "A100");
// an identifier without a number gets one: "B" -> "B1", "" -> "1". Returns "" when the trailing number
// is too large, when the numbers would pass kMaxMatNumber, or after maxTries used candidates.
std::string NextMat(std::string_view id, const std::function<bool(std::string_view)>& isUsed,
                    long long maxTries = kNextMatMaxTries);

// Whether the text, once normalised, is a correct identifier: not empty, valid UTF-8, no blank, no
// control character, none of the separators of a selection (',' ';'), no dash at either end (it would
// read as an unfinished range). `why` receives the French reason of a refusal (msg::kMatWhy...).
bool IsValidMat(std::string_view id, std::string* why = nullptr);

// Refuses an empty or malformed identifier with a warning message box ("PYRALIS") shown to parent, or
// to the application's front end when parent is null. True when the identifier is correct.
bool DDV_Mat(ui::FrontEnd* parent, std::string_view id);

// Exchange between an identifier field of a dialog and its value. Saving: the field's text is
// normalised and checked with DDV_Mat; when correct, the field shows the normal form and value receives
// it; when not, both stay as they were and false is returned. Otherwise the field shows the value.
bool DDX_Mat(ui::FrontEnd* parent, bool saveAndValidate, std::string& fieldText, std::string& value);

} // namespace pyr
