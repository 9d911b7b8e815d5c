// The words of a command line that are no option ("pyralis LecWild CARNET") and the options that take
// several values ("--lecture FORMAT CARNET").
#include "ui/DialogCommandLine.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

using namespace pyr;
using Kind = ui::CommandLineOutcome::Kind;
using Words = std::vector<std::string>;

namespace {

// Records what it is given; the field book "refuse.txt" is refused.
struct ReadingDialog : ui::Dialog {
    Words applied;

    ReadingDialog() { SetInputs({"derniere.geo", "p.ini", "/opt/", "lecture d'un carnet"}); }
    void DeclareOptions(ui::DialogOptions& options) override {
        options.Positional("CARNET", "le carnet à lire", [this](const std::string& path) {
            if (path == "refuse.txt") return std::string("Carnet refusé");
            applied.push_back("carnet=" + path);
            return std::string();
        });
        options.Positional("TABLE", "la table de codes", [this](const std::string& path) {
            applied.push_back("table=" + path);
            return std::string();
        });
        options.Values("lecture", {"FORMAT", "CARNET"}, "lit un carnet", [this](const Words& values) {
            applied.push_back("lecture=" + values.at(0) + "," + values.at(1));
            return std::string();
        });
        options.Switch("oui-ou-non", "un interrupteur", [this] {
            applied.push_back("switch");
            return std::string();
        });
    }
    ui::DialogResult Run(ui::FrontEnd&) override { return ui::DialogResult::Ok; }
};

std::string Hint(const std::string& fault) {
    return fault + "\nVoir : pyralis lire --help";
}

} // namespace

TEST(DialogPositional, WordsGoToThePositionalsInOrderBeforeTheOptions) {
    const struct {
        Words words;
        Kind kind;
        Words applied;
        std::string text;
    } cases[] = {
        {{"a.gsi"}, Kind::Run, {"carnet=a.gsi"}, ""},
        {{"--oui-ou-non", "a.gsi", "t.cod"}, Kind::Run, {"carnet=a.gsi", "table=t.cod", "switch"}, ""},
        {{"--lecture", "Wild", "c.gsi", "a.geo"}, Kind::Run, {"carnet=a.geo", "lecture=Wild,c.gsi"}, ""},
        {{"--lecture=Wild", "c.gsi"}, Kind::Run, {"lecture=Wild,c.gsi"}, ""},
        {{"--", "-carnet.txt"}, Kind::Run, {"carnet=-carnet.txt"}, ""},
        {{"a", "b", "c"}, Kind::Usage, {}, Hint("Argument inattendu : c")},
        {{"--lecture", "Wild"}, Kind::Usage, {}, Hint("Valeur manquante pour --lecture")},
        {{"--lecture", "Wild", "--oui-ou-non"}, Kind::Usage, {}, Hint("Valeur manquante pour --lecture")},
        {{"--lecture=Wild"}, Kind::Usage, {}, Hint("Valeur manquante pour --lecture")},
        {{"-x", "a"}, Kind::Usage, {}, Hint("Option inconnue : -x")},
        {{"refuse.txt", "--oui-ou-non"}, Kind::Refused, {}, "Carnet refusé"},
    };
    for (const auto& c : cases) {
        ReadingDialog dialog;
        const auto outcome = ui::ApplyCommandLine(dialog, "lire", c.words);
        EXPECT_EQ(outcome.kind, c.kind) << c.words.front();
        EXPECT_EQ(outcome.text, c.text) << c.words.front();
        EXPECT_EQ(dialog.applied, c.applied) << c.words.front();
    }
}

TEST(DialogPositional, TheHelpNamesThePositionalsAndTheValuesOfAnOption) {
    ReadingDialog dialog;
    const std::string help = ui::DialogHelp(dialog, "lire");
    EXPECT_EQ(help.substr(0, help.find('\n')), "Usage : pyralis lire [CARNET] [TABLE] [options]");
    EXPECT_NE(help.find("\n  CARNET                    le carnet à lire\n"), std::string::npos) << help;
    EXPECT_NE(help.find("\n  --lecture FORMAT CARNET   lit un carnet\n"), std::string::npos) << help;
}
