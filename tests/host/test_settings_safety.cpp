// "pyralis" commands meeting files they cannot write or read as they expect: a listing with nowhere to
// go, a full disk, a GéoBase named in Latin-1, a parameter file that is not text. What they say, how
// they end, and the files left behind.
#include "HostTestSupport.h"
#include "core/TextEncoding.h"

namespace {

using SettingsSafety = PyralisTest;

TEST_F(SettingsSafety, AListingThatCannotBeWrittenFailsTheCommandAndTheGeoBaseStaysSaved) {
    const std::string before = Demo("chantier.geo");
    const Outcome nowhere =
        Run("CalculV0 --geobase chantier.geo --type toutes --enregistrer --listing absent/v0.cv0 --oui");
    EXPECT_EQ(nowhere.status, 1) << nowhere.err;
    EXPECT_TRUE(Has(nowhere.err, "PYRALIS - Attention : Impossible d'écrire le fichier\n<absent/v0.cv0>\n"
                                 "(fichier ou dossier inexistant).\n"))
        << nowhere.err;
    EXPECT_TRUE(Has(nowhere.out, "GéoBase enregistrée dans <chantier.geo>.")) << nowhere.out;
    EXPECT_NE(ReadBytes(dir / "chantier.geo"), before);
    EXPECT_EQ(ReadBytes(dir / "chantier.bak"), before);
    EXPECT_TRUE(Has(ReadBytes(dir / "chantier.jnl"), " - Calcul des V0 de stations\nStation   S1(1) : V0 ="));

    // As on a full disk: the GéoBase (1.3 kB), its backup and the journal fit under 3 kB, the listing
    // (6 kB) does not. The listing of the day before, which this one was to complete, stays whole.
    Demo("plein.geo");
    WriteBytes(dir / "v0.cv0", "listing d'hier\n");
    const std::string run = "CalculV0 --geobase plein.geo --type toutes --enregistrer --listing v0.cv0 --oui";
    const Outcome full = Run(run, 3000);
    EXPECT_EQ(full.status, 1) << full.err;
    EXPECT_TRUE(Has(full.err,
                    "Impossible d'écrire le fichier\n<v0.cv0>\n(fichier trop grand pour la limite de "
                    "taille permise).\nLe fichier est resté tel qu'il était.\n"))
        << full.err;
    EXPECT_FALSE(Has(full.err, "Fichier à consulter")) << "a listing not written is not shown";
    EXPECT_EQ(ReadBytes(dir / "v0.cv0"), "listing d'hier\n");
    EXPECT_NE(ReadBytes(dir / "plein.geo"), before);
    EXPECT_EQ(ReadBytes(dir / "plein.bak"), before);

    // Without the limit the same run writes it: the limit, not something else, made it fail.
    const Outcome free = Run(run);
    EXPECT_EQ(free.status, 0) << free.err;
    EXPECT_GT(ReadBytes(dir / "v0.cv0").size(), 3000u);
}

TEST_F(SettingsSafety, AGeoBaseNamedInLatin1IsRememberedAndFoundAgainByTheNextCommand) {
    const std::string name = "relev\xE9.geo"; // as a Windows share or an old disk gives it
    Demo(name);
    const Outcome first = Run("GeoEdit --geobase '" + name + "'");
    ASSERT_EQ(first.status, 0) << first.err;
    const std::string params = ReadBytes(dir / "Pyralis.ini");
    EXPECT_TRUE(pyr::IsValidUtf8(params)) << params;
    EXPECT_TRUE(Has(params, "Derniere=" + dir.Root().string() + "/relev\uEFE9.geo")) << params;

    const Outcome second = Run("GeoEdit2");
    ASSERT_EQ(second.status, 0) << second.err;
    auto elements = [](const Outcome& outcome) { return outcome.out.substr(outcome.out.find("000001")); };
    EXPECT_EQ(elements(second), elements(first));
}

TEST_F(SettingsSafety, AParameterFileThatIsNotTextIsSetAsideWholeByTheFirstCommandThatWritesSettings) {
    // "[Options_Corrections]" saved in UTF-16 by an editor.
    std::string utf16 = "\xFF\xFE";
    for (const char c : std::string("[Options_Corrections]\r\n"))
        utf16 += std::string{c, '\0'};
    WriteBytes(dir / "Pyralis.ini", utf16);
    const std::string notText = "PYRALIS - Attention : Pyralis.ini :\nFichier de paramètres illisible (ce "
                                "n'est pas un fichier texte) !\n";

    const Outcome shown = Run("CalcOpt --afficher");
    EXPECT_EQ(shown.status, 0) << shown.err;
    EXPECT_TRUE(Has(shown.err, notText + "Les paramètres par défaut sont utilisés")) << shown.err;
    EXPECT_TRUE(Has(shown.out, "\nRayonTerre=6366.000000\n")) << "the default";
    EXPECT_EQ(ReadBytes(dir / "Pyralis.ini"), utf16);

    const Outcome set = Run("CalcOpt --regler Options_Corrections/RayonTerre=6400");
    EXPECT_EQ(set.status, 0) << set.err;
    EXPECT_TRUE(Has(set.err, notText + "Il a été mis de côté tel quel sous le nom\nPyralis.ini.illisible\n"))
        << set.err;
    EXPECT_EQ(ReadBytes(dir / "Pyralis.ini.illisible"), utf16);
    EXPECT_TRUE(Has(ReadBytes(dir / "Pyralis.ini"), "[Options_Corrections]\nRayonTerre=6400.000000\n"));
}

} // namespace
