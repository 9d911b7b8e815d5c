#include "geobase/Kinds.h"

#include <gtest/gtest.h>
#include <string>

using namespace pyr;

TEST(Kinds, EveryCommandCodeHasItsWordAndDescriptionBothWays) {
    EXPECT_EQ(CommandWord(kKindCommand), "Commande");
    EXPECT_EQ(CommandDescription("Commande"), "Commande non interprétée");
    EXPECT_EQ(CommandWord(1011), "PT_Sans_Ori");
    EXPECT_EQ(CommandWord(1040), "Rect_3Pts_H");
    EXPECT_EQ(CommandWord(1065), "Inter_Dist");
    EXPECT_EQ(CommandWord(1066), "");
    EXPECT_EQ(CommandDescription("Inter_Dist"), "Construction : Intersection par les distances");
    EXPECT_EQ(CommandDescription("Rect_3Pts_H"), "Polyligne : rectangle par 3 points (hauteur)");
    EXPECT_EQ(CommandDescription("ExcentTan"), "Excentrement tangentiel");
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

TEST(Kinds, AdditionReportsAreThoseTheEditorShows) {
    EXPECT_EQ(AddedReport(kKindLectAR), "Lecture AR de nivellement <%s> ajoutée dans la GéoBase");
    EXPECT_EQ(AddedReport(kKindLectAV), "Lecture AV de nivellement <%s> ajoutée dans la GéoBase");
    EXPECT_EQ(AddedReport(kKindPoint), "Point <%s> ajouté dans la GéoBase");
    EXPECT_EQ(AddedReport(1050), "Commande ajoutée dans la GéoBase");
    EXPECT_EQ(AddedReport(999), "");
}
