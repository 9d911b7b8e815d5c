#include "TestSupport.h"
#include "ui/ConsoleFrontEnd.h"
#include "ui/DialogCommandLine.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>

using namespace pyr;
using Kind = ui::CommandLineOutcome::Kind;
using ui::DialogResult;
using Words = std::vector<std::string>;

namespace {

// Records each option applied with the GéoBase current at that moment; the point "P99" is refused.
struct SightingDialog : ui::Dialog {
    Words applied;
    DialogResult runResult = DialogResult::Ok;

    SightingDialog() { SetInputs({"derniere.geo", "p.ini", "/opt/", "calcul d'un point visé"}); }
    void DeclareOptions(ui::DialogOptions& options) override {
        options.Value(
            "point", "NOM", "un point visé", [this](const std::string& p) { return Record(p); }, true);
        options.Switch("listing", "termine avec le listing", [this] { return Record("listing"); });
    }
    std::string Record(const std::string& what) {
        if (what == "P99") return "Point inconnu : P99";
        applied.push_back(what + " @" + GeoBase());
        return {};
    }
    DialogResult Run(ui::FrontEnd& frontEnd) override {
        frontEnd.TextLine("calcul sur " + GeoBase());
        return runResult;
    }
};

const std::string kHelp = "Usage : pyralis calvis [options]\n"
                          "calcul d'un point visé\n\n"
                          "Options :\n"
                          "  --geobase FICHIER   la GéoBase à traiter, au lieu de la dernière utilisée\n"
                          "  --point NOM         un point visé (répétable)\n"
                          "  --listing           termine avec le listing\n"
                          "  -h, --help          affiche cette aide\n"
                          "  --params CHEMIN, --oui, --non : voir pyralis --help";

std::string Hint(const std::string& fault) {
    return fault + "\nVoir : pyralis calvis --help";
}

} // namespace

TEST(DialogCommandLine, OptionsApplyInTheOrderGivenWithTheirValuesAsWritten) {
    SightingDialog dialog;
    const std::string base = "/tmp/Étude n°2/chantier.geo";
    const Words words{"--point", "A", "--geobase", base, "--listing", "--point=B=2", "--point", "-12.5"};
    EXPECT_EQ(ui::ApplyCommandLine(dialog, "calvis", words).kind, Kind::Run);
    EXPECT_EQ(dialog.applied,
              (Words{"A @derniere.geo", "listing @" + base, "B=2 @" + base, "-12.5 @" + base}));
    EXPECT_TRUE(dialog.GeoBaseNamed());
}

// Every line follows "--point A": the help or a usage fault anywhere applies nothing, not even the point.
TEST(DialogCommandLine, HelpOrAFaultAppliesNothingAndTheFirstRefusalStopsTheRest) {
    // clang-format off
    const struct { Words tail; Kind kind; std::string text; } cases[] = {
        {{"--inconnue", "--geobase", "--help"}, Kind::Help, kHelp},
        {{"--foo=1", "xyz"}, Kind::Usage, Hint("Option inconnue : --foo")},
        {{"--", "-h"}, Kind::Usage, Hint("Argument inattendu : -h")},
        {{"--geobase", "-v"}, Kind::Usage, Hint("Valeur manquante pour --geobase")},
        {{"--listing=oui"}, Kind::Usage, Hint("L'option ne prend pas de valeur : --listing")},
        {{"--geobase", "a.geo", "--geobase=b.geo"}, Kind::Usage, Hint("Option donnée plusieurs fois : --geobase")},
        {{"--point", "P99", "--geobase", "b"}, Kind::Refused, "Point inconnu : P99"},
    };
    // clang-format on
    for (const auto& [tail, kind, text] : cases) {
        SightingDialog dialog;
        Words words{"--point", "A"};
        words.insert(words.end(), tail.begin(), tail.end());
        auto outcome = ui::ApplyCommandLine(dialog, "calvis", words);
        EXPECT_EQ(outcome.kind, kind) << text;
        EXPECT_EQ(outcome.text, text);
        EXPECT_EQ(dialog.applied, kind == Kind::Refused ? Words{"A @derniere.geo"} : Words{}) << text;
        EXPECT_FALSE(dialog.GeoBaseNamed()) << text;
    }
}

// "--listing [FICHIER]": the value is taken when a word that is not an option follows.
TEST(DialogCommandLine, AnOptionalValueIsTakenOnlyWhenGiven) {
    struct ListingDialog : SightingDialog {
        void DeclareOptions(ui::DialogOptions& options) override {
            SightingDialog::DeclareOptions(options);
            options.OptionalValue("fichier", "NOM", "le listing",
                                  [this](const std::string& f) { return Record("fichier=" + f); });
        }
    };
    // clang-format off
    const struct { Words words; Kind kind; Words applied; } cases[] = {
        {{"--fichier"}, Kind::Run, {"fichier= @derniere.geo"}},
        {{"--fichier", "l.cv0", "--point", "A"}, Kind::Run, {"fichier=l.cv0 @derniere.geo", "A @derniere.geo"}},
        {{"--fichier", "--point", "A"}, Kind::Run, {"fichier= @derniere.geo", "A @derniere.geo"}},
        {{"--fichier=l.cv0"}, Kind::Run, {"fichier=l.cv0 @derniere.geo"}},
        {{"--fichier", "a", "b"}, Kind::Usage, {}},
        {{"--fichier", "--fichier"}, Kind::Usage, {}}, // twice without a value: no value to read
    };
    // clang-format on
    for (const auto& c : cases) {
        ListingDialog dialog;
        EXPECT_EQ(ui::ApplyCommandLine(dialog, "calvis", c.words).kind, c.kind) << c.words.size();
        EXPECT_EQ(dialog.applied, c.applied);
    }
    ListingDialog dialog;
    EXPECT_NE(ui::DialogHelp(dialog, "calvis").find("  --fichier [NOM]     le listing\n"), std::string::npos)
        << ui::DialogHelp(dialog, "calvis");
}

TEST(ConsoleFrontEnd, ADialogsOutcomeGoesToItsStreamAndGivesTheStatus) {
    using enum DialogResult;
    // clang-format off
    struct Case { Words words; DialogResult run, result; int status; std::string out, err; };
    const Case cases[] = {
        {{}, Failed, Failed, 1, "calcul sur derniere.geo\n", ""},
        {{"--help"}, Ok, Cancel, 0, kHelp + "\n", ""},
        {{"--foo"}, Ok, Failed, 2, "", "pyralis calvis : " + Hint("Option inconnue : --foo") + "\n"},
        {{"--point", "P99"}, Ok, Failed, 1, "", "PYRALIS - Attention : Point inconnu : P99\n"},
    };
    // clang-format on
    for (const auto& c : cases) {
        std::FILE* out = std::tmpfile();
        std::FILE* err = std::tmpfile();
        ui::ConsoleFrontEnd console(nullptr, out, err);
        console.SetCommand("calvis", c.words);
        SightingDialog dialog, later;
        dialog.runResult = c.run;
        EXPECT_EQ(console.DoModal(dialog), c.result) << c.err;
        EXPECT_EQ(Contents(out), c.out);
        EXPECT_EQ(Contents(err), c.err);
        // A later dialog does not hide an earlier failure; the next command starts afresh.
        console.DoModal(later);
        EXPECT_EQ(console.Status(), c.status) << c.err;
        console.SetCommand("calvis", {});
        EXPECT_EQ(console.Status(), 0);
        std::fclose(out);
        std::fclose(err);
    }
}

// A dialog opened from another gets the same words and records its result after the other's.
TEST(ScriptedFrontEnd, EveryDialogGetsTheArgumentsAndIsRecordedInTheOrderOpened) {
    using enum DialogResult;
    struct Outer : SightingDialog {
        SightingDialog inner;
        DialogResult Run(ui::FrontEnd& frontEnd) override {
            return frontEnd.DoModal(inner) == Cancel ? Ok : Failed;
        }
    } outer;
    outer.inner.runResult = Cancel;
    ui::ScriptedFrontEnd fe;
    fe.command = "calvis";
    fe.dialogArguments = {"--geobase", "b.geo"};
    EXPECT_EQ(fe.DoModal(outer), Ok);
    EXPECT_EQ(fe.AllLines(), "calcul sur b.geo");
    fe.dialogArguments = {"xyz"};
    fe.DoModal(outer);
    EXPECT_EQ(fe.messages.size(), 1u) << "the usage fault shown";
    EXPECT_EQ(fe.results, (std::vector<DialogResult>{Ok, Cancel, Failed}));
}
