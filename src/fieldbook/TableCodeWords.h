#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

// The words of a field code ("ARB 0.40", "TXT \"Mur de soutènement\"") and of the lines of a code
// table, and how codes and command words are compared. Texts are UTF-8.
namespace pyr {

// Splits the text into words separated by blanks and tabulations. A word that starts with a double quote
// runs to the next double quote, blanks included, without its quotes (to the end of the text when the
// quote is not closed); elsewhere a double quote is an ordinary character. The strings already in
// `words` are reused, so that splitting line after line allocates nothing. Returns the number of words.
std::size_t SplitWords(std::string_view text, std::vector<std::string>& words);

// The index of the first ';' of a line of a code table that is not inside double quotes, or npos.
std::size_t CommentStart(std::string_view line);

// Appends a word to a line of words, after a blank unless the line is empty, in double quotes when
// SplitWords would not read it back as the same one word (empty, or holding a blank or a tabulation).
void AppendWord(std::string& line, std::string_view word);

// The key under which a field code is looked up: its letters in upper case, accented ones included
// ("écl" and "ÉCL" are one code, "ECL" another).
std::string CodeKey(std::string_view code);

// The key under which a command word is looked up: upper case and without accents, so that a table
// typed on a keyboard without them still names "Sym_Orienté" ("SYM_ORIENTE").
std::string CommandKey(std::string_view word);

// The command word of the interpreted commands (kinds 1010 to 1065) that the word names, compared by
// CommandKey, with its own spelling ("sym_oriente" gives "Sym_Orienté"); empty when it names none.
// The generic "Commande" of kind 1009 is not one of them.
std::string_view InterpretedCommandWord(std::string_view word);

// Whether the character that starts at byte `index` of a UTF-8 text is an upper-case or a lower-case
// letter: ASCII, the accented letters of Latin-1 and Œ, œ, Ÿ. `length` receives its length in bytes
// (1 for a byte that does not start a valid character of these).
bool IsUpperCaseLetterAt(std::string_view text, std::size_t index, std::size_t& length);
bool IsLowerCaseLetterAt(std::string_view text, std::size_t index, std::size_t& length);

} // namespace pyr
