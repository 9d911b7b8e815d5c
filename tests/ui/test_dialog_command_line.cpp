// Dialogs driven from a command line: options applied in the order given, French faults, the help,
// and what the console and the scripted front end make of each outcome.
#include "TestSupport.h"
#include "ui/ConsoleFrontEnd.h"
#include "ui/DialogCommandLine.h"
#include "ui/ScriptedFrontEnd.h"

#include <cstdio>
#include <gtest/gtest.h>
#include <string>
#include <vector>

using namespace pyr;
using Kind = ui::CommandLineOutcome::Kind;
using ui::DialogResult;
using Words = std::vector<std::string>;

namespace {

// Records every option applied with the GéoBase current at that moment: a point name is looked up in
// the GéoBase named before it. "P99" is refused.
class SightingDialog : public ui::DialogModel {
public:
    Words applied;
    DialogResult runResult = DialogResult::Ok;

    SightingDialog() {
        SetInputs({"derniere.geo", "Pyralis.ini", "/opt/pyralis/", "calcul d'un point visé"});
    }

    void DeclareOptions(ui::DialogOptions& options) override {
        auto record = [this](std::string what) {
            applied.push_back(std::move(what));
            return std::string();
        };
        options.Value(
            "point", "NOM", "un point visé",
            [=, this](const std::string& name) {
                return name == "P99" ? "Point inconnu : " + name : record("point " + name + " @" + GeoBase());
            },
            true);
        options.Value("titre", "TEXTE", "le titre du listing",
                      [=](const std::string& t) { return record("titre " + t); });
        options.Switch("listing", "termine avec le listing", [=] { return record("listing"); });
    }

    DialogResult Run(ui::FrontEnd& frontEnd) override {
        frontEnd.TextLine("calcul sur " + GeoBase());
        return runResult;
    }
};

std::string Hint(const std::string& fault) {
    return fault + "\nVoir : pyralis calvis --help";
}

} // namespace

TEST(DialogCommandLine, OptionsApplyInTheOrderGivenWithTheirValuesAsWritten) {
    SightingDialog dialog;
    const std::string base = "/tmp/Étude n°2/chantier.geo";
    auto outcome = ui::ApplyCommandLine(dialog, "calvis",
                                        {"--point", "A", "--geobase", base, "--listing", "--point=B=2",
                                         "--titre=-3,5 m", "--point", "Borne été", "--point", "-12.5"});
    EXPECT_EQ(outcome.kind, Kind::Run);
    EXPECT_EQ(dialog.applied, (Words{"point A @derniere.geo", "listing", "point B=2 @" + base, "titre -3,5 m",
                                     "point Borne été @" + base, "point -12.5 @" + base}));
    EXPECT_EQ(dialog.GeoBase(), base);
    EXPECT_TRUE(dialog.GeoBaseNamed());

    SightingDialog offered;
    EXPECT_EQ(ui::ApplyCommandLine(offered, "calvis", {"--listing", "--"}).kind, Kind::Run);
    EXPECT_EQ(offered.GeoBase(), "derniere.geo");
    EXPECT_FALSE(offered.GeoBaseNamed());
}

TEST(DialogCommandLine, HelpAnywhereGivesTheHelpAndAppliesNothing) {
    for (const Words& words : {Words{"--point", "A", "-h"}, Words{"--titre", "--help"},
                               Words{"--geobase", "x.geo", "--inconnue", "--help"}}) {
        SightingDialog dialog;
        auto outcome = ui::ApplyCommandLine(dialog, "calvis", words);
        EXPECT_EQ(outcome.kind, Kind::Help) << words.back();
        EXPECT_EQ(outcome.text, ui::DialogHelp(dialog, "calvis"));
        EXPECT_TRUE(dialog.applied.empty());
        EXPECT_FALSE(dialog.GeoBaseNamed());
    }

    SightingDialog dialog;
    EXPECT_EQ(ui::DialogHelp(dialog, "calvis"),
              "Usage : pyralis calvis [options]\n"
              "calcul d'un point visé\n"
              "\n"
              "Options :\n"
              "  --geobase FICHIER   la GéoBase à traiter, au lieu de la dernière utilisée\n"
              "  --point NOM         un point visé (répétable)\n"
              "  --titre TEXTE       le titre du listing\n"
              "  --listing           termine avec le listing\n"
              "  -h, --help          affiche cette aide\n"
              "  --params CHEMIN, --oui, --non : voir pyralis --help");
}

TEST(DialogCommandLine, WordsThatDoNotParseAreNamedInFrenchAndNothingIsApplied) {
    const std::pair<Words, std::string> cases[] = {
        {{"--foo"}, "Option inconnue : --foo"},
        {{"--foo=1", "xyz"}, "Option inconnue : --foo"},
        {{"-x"}, "Option inconnue : -x"},
        {{"--Point", "B"}, "Option inconnue : --Point"},
        {{"xyz"}, "Argument inattendu : xyz"},
        {{"--listing", "oui"}, "Argument inattendu : oui"},
        {{"--", "--listing"}, "Argument inattendu : --listing"},
        {{"--geobase"}, "Valeur manquante pour --geobase"},
        {{"--geobase="}, "Valeur manquante pour --geobase"},
        {{"--titre", "--listing"}, "Valeur manquante pour --titre"},
        {{"--titre", "-v"}, "Valeur manquante pour --titre"},
        {{"--listing=oui"}, "L'option ne prend pas de valeur : --listing"},
        {{"--titre", "a", "--titre", "b"}, "Option donnée plusieurs fois : --titre"},
        {{"--listing", "--listing"}, "Option donnée plusieurs fois : --listing"},
        {{"--geobase", "a.geo", "--geobase=b.geo"}, "Option donnée plusieurs fois : --geobase"},
    };
    for (const auto& [tail, fault] : cases) {
        SightingDialog dialog;
        Words words{"--point", "A"};
        words.insert(words.end(), tail.begin(), tail.end());
        auto outcome = ui::ApplyCommandLine(dialog, "calvis", words);
        EXPECT_EQ(outcome.kind, Kind::Usage) << fault;
        EXPECT_EQ(outcome.text, Hint(fault));
        EXPECT_TRUE(dialog.applied.empty()) << fault;
        EXPECT_FALSE(dialog.GeoBaseNamed()) << fault;
    }
}

TEST(DialogCommandLine, TheFirstRefusalStopsTheRest) {
    SightingDialog dialog;
    auto outcome =
        ui::ApplyCommandLine(dialog, "calvis", {"--point", "A", "--point", "P99", "--geobase", "b"});
    EXPECT_EQ(outcome.kind, Kind::Refused);
    EXPECT_EQ(outcome.text, "Point inconnu : P99");
    EXPECT_EQ(dialog.applied, Words{"point A @derniere.geo"});
    EXPECT_FALSE(dialog.GeoBaseNamed());

    // A dialog declaring a name twice is a fault of the program: refused, never thrown.
    struct Twice : SightingDialog {
        void DeclareOptions(ui::DialogOptions& options) override { options.Switch("geobase", "", nullptr); }
    } twice;
    outcome = ui::ApplyCommandLine(twice, "calvis", {});
    EXPECT_EQ(outcome.kind, Kind::Refused);
    EXPECT_EQ(outcome.text, "Option de dialogue mal déclarée : --geobase");
}

TEST(ConsoleFrontEnd, ADialogsOutcomeGoesToItsStreamAndGivesTheStatus) {
    struct Case {
        Words words;
        DialogResult run, result;
        int status;
        std::string out, err;
    };
    SightingDialog help;
    const auto ok = DialogResult::Ok, cancel = DialogResult::Cancel, failed = DialogResult::Failed;
    // clang-format off
    const Case cases[] = {
        {{"--geobase", "b.geo"}, ok, ok, 0, "calcul sur b.geo\n", ""},
        {{}, cancel, cancel, 0, "calcul sur derniere.geo\n", ""},
        {{}, failed, failed, 1, "calcul sur derniere.geo\n", ""},
        {{"--help"}, ok, cancel, 0, ui::DialogHelp(help, "calvis") + "\n", ""},
        {{"--foo"}, ok, failed, 2, "", "pyralis calvis : " + Hint("Option inconnue : --foo") + "\n"},
        {{"--point", "P99"}, ok, failed, 1, "", "PYRALIS - Attention : Point inconnu : P99\n"},
    };
    // clang-format on
    for (const auto& c : cases) {
        std::FILE* out = std::tmpfile();
        std::FILE* err = std::tmpfile();
        ui::ConsoleFrontEnd console(nullptr, out, err);
        console.SetCommand("calvis", c.words);
        SightingDialog dialog;
        dialog.runResult = c.run;
        EXPECT_EQ(console.DoModal(dialog), c.result) << c.err;
        EXPECT_EQ(console.Status(), c.status) << c.err;
        EXPECT_EQ(Contents(out), c.out);
        EXPECT_EQ(Contents(err), c.err);
        // A later dialog of the same command does not hide an earlier failure; the next command starts
        // afresh.
        SightingDialog later;
        console.DoModal(later);
        EXPECT_EQ(console.Status(), c.status) << c.err;
        console.SetCommand("calvis", {});
        EXPECT_EQ(console.Status(), 0);
        std::fclose(out);
        std::fclose(err);
    }
}

TEST(ScriptedFrontEnd, EveryDialogGetsTheArgumentsAndIsRecordedInTheOrderOpened) {
    ui::ScriptedFrontEnd fe;
    fe.command = "calvis";
    fe.dialogArguments = {"--geobase", "b.geo", "--listing"};
    SightingDialog dialog;
    EXPECT_EQ(fe.DoModal(dialog), DialogResult::Ok);
    EXPECT_EQ(dialog.applied, Words{"listing"});
    EXPECT_EQ(fe.lines, Words{"calcul sur b.geo"});

    fe.dialogArguments = {"--point", "P99"};
    EXPECT_EQ(fe.DoModal(dialog), DialogResult::Failed);
    fe.dialogArguments = {"xyz"};
    EXPECT_EQ(fe.DoModal(dialog), DialogResult::Failed);
    ASSERT_EQ(fe.messages.size(), 2u);
    EXPECT_EQ(fe.messages[0].text, "Point inconnu : P99");
    EXPECT_EQ(fe.messages[1].text, Hint("Argument inattendu : xyz"));
    EXPECT_EQ(fe.messages[1].icon, ui::kIconWarning);

    fe.lines.clear();
    fe.dialogArguments = {"-h"};
    EXPECT_EQ(fe.DoModal(dialog), DialogResult::Cancel);
    EXPECT_EQ(fe.AllLines(), ui::DialogHelp(dialog, "calvis"));

    // A dialog opened from another is recorded after it, its result in its own place.
    struct Outer : SightingDialog {
        SightingDialog inner;
        std::string Caption() const override { return "extérieur"; }
        DialogResult Run(ui::FrontEnd& frontEnd) override {
            inner.runResult = DialogResult::Failed;
            return frontEnd.DoModal(inner) == DialogResult::Failed ? DialogResult::Ok : DialogResult::Failed;
        }
    } outer;
    fe.dialogArguments.clear();
    fe.DoModal(outer);
    EXPECT_EQ(fe.dialogs, (Words{"calcul d'un point visé", "calcul d'un point visé", "calcul d'un point visé",
                                 "calcul d'un point visé", "extérieur", "calcul d'un point visé"}));
    EXPECT_EQ(fe.results,
              (std::vector<DialogResult>{DialogResult::Ok, DialogResult::Failed, DialogResult::Failed,
                                         DialogResult::Cancel, DialogResult::Ok, DialogResult::Failed}));
}

TEST(ScriptedFrontEnd, AFileChoiceWithNoFileLeftTakesThePathItOffers) {
    ui::ScriptedFrontEnd fe;
    fe.files = {std::nullopt};
    ui::FileChoice choice{false, "Sélectionnez la GéoBase :", "GéoBase PYRALIS (*.geo)|*.geo||", "geo",
                          "a.geo"};
    EXPECT_EQ(fe.ChooseFile(choice), std::nullopt); // cancelled in advance
    EXPECT_EQ(fe.ChooseFile(choice), "a.geo");
    choice.startPath.clear();
    EXPECT_EQ(fe.ChooseFile(choice), std::nullopt);
}
