#include "geobase/Kinds.h"

#include <gtest/gtest.h>
#include <string>

using namespace pyr;

TEST(Kinds, EveryCommandCodeHasItsWordAndDescriptionBothWays) {
    EXPECT_EQ(CommandWord(kKindCommand), "Commande");
    EXPECT_EQ(CommandDescription("Commande"), "Commande non interprétée");
    EXPECT_EQ(CommandWord(kKindLastCommand + 1), "");
    for (int kind = 1011; kind <= kKindLastCommand; ++kind) {
        std::string_view word = CommandWord(kind);
        EXPECT_FALSE(word.empty()) << kind;
        EXPECT_EQ(CommandKind(word), kind) << word;
        EXPECT_FALSE(CommandDescription(word).empty()) << word;
    }
    // The three eccentric offsets share one code; an unknown word is a plain command.
    EXPECT_EQ(CommandKind("ExcentRad"), kKindExcentrement);
    EXPECT_EQ(CommandKind("excentver"), kKindExcentrement);
    EXPECT_EQ(CommandKind("Sym_Entrée"), 1033);
    EXPECT_EQ(CommandKind("MUR"), kKindCommand);
}
