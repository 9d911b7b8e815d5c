#include "TestSupport.h"
#include "ui/ConsoleFrontEnd.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>

using namespace pyr;

TEST(TextWindow, EachNewlineEndsALineAndATrailingOneAddsNone) {
    ui::ScriptedFrontEnd fe;
    CPyrTxtWnd txt(fe);
    txt.Print("\nCréation de la GéoBase en cours ...");
    txt.Print("Erreur ligne %d : donnée non reconnue !", 12);
    txt.Print("fin\n");
    std::vector<std::string> expected{"", "Création de la GéoBase en cours ...",
                                      "Erreur ligne 12 : donnée non reconnue !", "fin"};
    EXPECT_EQ(fe.lines, expected);
    EXPECT_EQ(txt.LineCount(), 4);
}

TEST(ConsoleFrontEnd, InBatchAQuestionTakesTheAnswerGivenInAdvanceOrItsDefault) {
    std::FILE* out = std::tmpfile();
    std::FILE* err = std::tmpfile();
    ui::ConsoleFrontEnd console(nullptr, out, err);
    console.SetInteractive(false);
    EXPECT_EQ(console.Ask("Voulez-vous continuer ?", ui::kCaption, ui::Buttons::YesNo, ui::Answer::No),
              ui::Answer::No);
    console.SetBatchAnswer(ui::Answer::Yes);
    EXPECT_EQ(console.Ask("Remplacer ?", ui::kCaption, ui::Buttons::YesNoCancel, ui::Answer::Cancel),
              ui::Answer::Yes);
    console.MessageBox("Fichier de paramètres inexistant !", ui::kCaption, ui::kIconWarning);
    console.TextLine("ligne");
    std::string messages = Contents(err);
    EXPECT_NE(messages.find("Réponse : Non"), std::string::npos);
    EXPECT_NE(messages.find("Réponse : Oui"), std::string::npos);
    EXPECT_NE(messages.find("PYRALIS - Attention : Fichier de paramètres inexistant !"), std::string::npos);
    EXPECT_EQ(Contents(out), "ligne\n");
    std::fclose(out);
    std::fclose(err);
}
