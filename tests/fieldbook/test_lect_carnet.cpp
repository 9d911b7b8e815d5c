// The reading dialog: what it shows, its browse buttons, and the checks of OK in their order.
#include "FieldBookTestSupport.h"
#include "fieldbook/LectCarnet.h"

#include <filesystem>
#include <gtest/gtest.h>

using namespace pyr;
using ui::Answer;
using ui::DialogResult;
using Field = CLectCarnet::Field;

namespace {

class LectCarnet : public ::testing::Test {
protected:
    LectCarnet() : params(dir / "Pyralis.ini"), dialog(FieldBookFormat::Wild, params, dir.Path("")) {
        WriteBytes(dir / "carnet.gsi", "STATION;S1;1.5\n");
        WriteBytes(dir / "Wild.ini", "[Parametrage]\n");
        WriteBytes(dir / "job.cod", "Séparateur = A...Z\nPIQ ExcentRad\n");
        dialog.SetCarnetFromSettings(dir / "carnet.gsi");
        dialog.SetParamFile(dir / "Wild.ini");
    }
    TempDir dir;
    CParamFile params;
    CLectCarnet dialog;
    ui::ScriptedFrontEnd frontEnd;
};

} // namespace

TEST_F(LectCarnet, WhatTheDialogShows) {
    EXPECT_EQ(dialog.Caption(), "Lecture du carnet Wild");
    EXPECT_TRUE(dialog.GeoBaseFieldVisible());
    dialog.SetCreateNew(false);
    EXPECT_FALSE(dialog.GeoBaseFieldVisible());
    // The instrument combo and the code table follow their boxes.
    EXPECT_FALSE(dialog.InstrumentEnabled());
    EXPECT_FALSE(dialog.CodeTableEnabled());
    dialog.SetWriteInstrument(true);
    dialog.SetInterpret(true);
    EXPECT_TRUE(dialog.InstrumentEnabled());
    EXPECT_TRUE(dialog.CodeTableEnabled());
    // The instrument named by the settings, else the first of the list.
    dialog.SetInstruments({{"Appareil Standard"}, {"TCR 307"}});
    dialog.SetInstrumentName("TCR 307");
    EXPECT_EQ(dialog.InstrumentIndex(), 1);
    dialog.SetInstrumentName("Disparu");
    EXPECT_EQ(dialog.InstrumentIndex(), 0);
    EXPECT_EQ(dialog.Choices().instrumentName, "Appareil Standard");
}

// An empty "Carnet" key leaves the GéoBase to create empty until a field book is chosen.
TEST_F(LectCarnet, ChoosingAFieldBookNamesTheGeoBaseBesideIt) {
    dialog.SetCarnetFromSettings("");
    EXPECT_EQ(dialog.GeoBasePath(), "");
    frontEnd.files.push_back(dir / "levé.du.3.txt");
    EXPECT_TRUE(dialog.BrowseCarnet(frontEnd));
    EXPECT_EQ(dialog.GeoBasePath(), dir / "levé.du.3.geo");
    frontEnd.files.push_back(std::nullopt); // the person cancels: nothing changes
    EXPECT_FALSE(dialog.BrowseCarnet(frontEnd));
    EXPECT_EQ(dialog.Carnet(), dir / "levé.du.3.txt");
}

TEST_F(LectCarnet, TheBrowseButtonsTitlesAndFilters) {
    dialog.BrowseCarnet(frontEnd);
    dialog.BrowseGeoBase(frontEnd);
    dialog.BrowseParamFile(frontEnd);
    dialog.BrowseCodeTable(frontEnd);
    CLectCarnet delimited(FieldBookFormat::Separateur, params, "");
    delimited.BrowseParamFile(frontEnd);
    CLectCarnet columnar(FieldBookFormat::Colonne, params, "");
    columnar.BrowseParamFile(frontEnd);
    const struct {
        bool save;
        const char* title;
        const char* filter;
        const char* extension;
    } expected[] = {
        {false, "Sélectionnez le fichier carnet à traiter :", "Tous les fichiers (*.*)|*.*||", ""},
        {true, "Nom de la GéoBase à créer :", "GéoBase PYRALIS (*.geo)|*.geo||", "geo"},
        {false, "Sélectionnez le fichier de paramétrage à utiliser :",
         "Fichiers de paramètres (*.ini)|*.ini||", "ini"},
        {false, "Nom de la table à utiliser :", "Table de Codes PYRALIS (*.cod)|*.cod||", "cod"},
        {false, "Sélectionnez le fichier de paramétrage à utiliser :",
         "Fichiers de paramètres (*.sep)|*.sep||", "sep"},
        {false, "Sélectionnez le fichier de paramétrage à utiliser :",
         "Fichiers de paramètres (*.col)|*.col||", "col"},
    };
    ASSERT_EQ(frontEnd.fileChoices.size(), std::size(expected));
    for (std::size_t i = 0; i < std::size(expected); ++i) {
        EXPECT_EQ(frontEnd.fileChoices[i].save, expected[i].save) << i;
        EXPECT_EQ(frontEnd.fileChoices[i].title, expected[i].title) << i;
        EXPECT_EQ(frontEnd.fileChoices[i].filter, expected[i].filter) << i;
        EXPECT_EQ(frontEnd.fileChoices[i].defaultExtension, expected[i].extension) << i;
    }
}

// Each check in its order; a failure sends the person back to its field, a question answered No too.
TEST_F(LectCarnet, TheChecksOfOkInTheirOrder) {
    const std::string noTable =
        "Aucune table de codes n'est indiquée.\nVoulez-vous qu'aucune commande ne soit "
        "interprétée ?";
    const std::string missingTable =
        "La table de codes indiquée n'existe pas.\nVoulez-vous qu'aucune commande ne "
        "soit interprétée ?";
    const std::string replace = "La GéoBase indiquée existe déjà !\nVoulez-vous la remplacer ?";
    struct Case {
        const char* what;
        std::function<void(CLectCarnet&)> set;
        std::vector<Answer> answers;
        DialogResult result;
        Field focus;
        std::vector<std::string> questions;
        std::string message;
    };
    const std::string geo = dir / "carnet.geo";
    const Case cases[] = {
        {"tout va bien", [](CLectCarnet&) {}, {}, DialogResult::Ok, Field::None, {}, ""},
        {"carnet absent, et tout le reste faux",
         [&](CLectCarnet& d) {
             d.SetCarnet(dir / "absent.gsi");
             d.SetParamFile(dir / "absent.ini");
             d.SetInterpret(true);
         },
         {},
         DialogResult::Failed,
         Field::Carnet,
         {},
         "Le fichier carnet indiqué n'existe pas !"},
        {"paramétrage absent",
         [&](CLectCarnet& d) { d.SetParamFile(dir / "absent.ini"); },
         {},
         DialogResult::Failed,
         Field::ParamFile,
         {},
         "Le fichier de paramétrage indiqué n'existe pas !"},
        {"pas de table, non",
         [](CLectCarnet& d) { d.SetInterpret(true); },
         {Answer::No},
         DialogResult::Cancel,
         Field::CodeTable,
         {noTable},
         ""},
        {"table absente, oui",
         [&](CLectCarnet& d) {
             d.SetInterpret(true);
             d.SetCodeTablePath("  " + dir / "absente.cod" + " ");
         },
         {Answer::Yes},
         DialogResult::Ok,
         Field::None,
         {missingTable},
         ""},
        {"paramétrage faux",
         [&](CLectCarnet&) { WriteBytes(dir / "Wild.ini", "[Parametrage]\nReferences=toutes\n"); },
         {},
         DialogResult::Failed,
         Field::CodeTable,
         {},
         "Fichier de paramétrage <" + dir / "Wild.ini" +
             "> :\nvaleur « toutes » incorrecte pour References (valeurs possibles : aucune, premiere, "
             "codes) !"},
        {"GéoBase existante, non",
         [&](CLectCarnet&) { WriteBytes(geo, ""); },
         {Answer::No},
         DialogResult::Cancel,
         Field::GeoBase,
         {replace},
         ""},
        {"GéoBase existante, oui",
         [&](CLectCarnet&) { WriteBytes(geo, ""); },
         {Answer::Yes},
         DialogResult::Ok,
         Field::None,
         {replace},
         ""},
    };
    for (const Case& c : cases) {
        WriteBytes(dir / "Wild.ini", "[Parametrage]\n");
        std::filesystem::remove(geo);
        CLectCarnet d(FieldBookFormat::Wild, params, "");
        d.SetCarnetFromSettings(dir / "carnet.gsi");
        d.SetParamFile(dir / "Wild.ini");
        c.set(d);
        ui::ScriptedFrontEnd fe;
        fe.answers.assign(c.answers.begin(), c.answers.end());
        EXPECT_EQ(d.OnOK(fe), c.result) << c.what;
        EXPECT_EQ(d.FocusField(), c.focus) << c.what;
        EXPECT_EQ(fe.questions, c.questions) << c.what;
        if (c.message.empty()) {
            EXPECT_TRUE(fe.messages.empty()) << c.what;
        } else {
            ASSERT_EQ(fe.messages.size(), 1u) << c.what;
            EXPECT_EQ(fe.messages[0].text, c.message) << c.what;
        }
    }
}

// Going on without the missing table reads the codes as they stand.
TEST_F(LectCarnet, WithoutItsTableNoCommandIsInterpreted) {
    dialog.SetInterpret(true);
    frontEnd.answers = {Answer::Yes};
    ASSERT_EQ(dialog.OnOK(frontEnd), DialogResult::Ok);
    EXPECT_TRUE(dialog.NoCodeTable());
    EXPECT_FALSE(dialog.Choices().interpret);
    EXPECT_TRUE(dialog.Interpret()); // the box stays ticked
}

// The Quendal-Pc dialog has no parameter file to check.
TEST_F(LectCarnet, TheQuendalDialogHasNoParameterFile) {
    CLecQuendal quendal(params, "");
    quendal.SetCarnetFromSettings(dir / "carnet.gsi");
    EXPECT_EQ(quendal.Caption(), "Lecture du carnet Quendal-Pc");
    EXPECT_FALSE(quendal.HasParamFile());
    EXPECT_EQ(quendal.OnOK(frontEnd), DialogResult::Ok);
}

TEST_F(LectCarnet, EditingTheParametersAsksToCreateAMissingFileAndShowsIt) {
    dialog.SetParamFile(dir / "Nouveau.ini");
    frontEnd.answers = {Answer::No, Answer::Yes};
    EXPECT_FALSE(dialog.OnEditParams(frontEnd));
    EXPECT_EQ(dialog.FocusField(), Field::ParamFile);
    EXPECT_TRUE(frontEnd.shownFiles.empty());
    EXPECT_TRUE(dialog.OnEditParams(frontEnd));
    EXPECT_EQ(frontEnd.questions,
              std::vector<std::string>(
                  2, "Le fichier de paramétrage indiqué n'existe pas !\nVoulez-vous en créer un "
                     "nouveau ?"));
    EXPECT_EQ(frontEnd.shownFiles, std::vector<std::string>{dir / "Nouveau.ini"});
    EXPECT_TRUE(std::filesystem::exists(dir / "Nouveau.ini"));

    // The delimited layout is also recorded for the loading of points.
    CLectCarnet delimited(FieldBookFormat::Separateur, params, "");
    delimited.SetParamFile(dir / "Mon.sep");
    frontEnd.answers = {Answer::Yes};
    EXPECT_TRUE(delimited.OnEditParams(frontEnd));
    std::string recorded;
    params.ReadString("ChargementDeSemis", "ParametresSeparateur", "", recorded);
    EXPECT_EQ(recorded, dir / "Mon.sep");
}

TEST_F(LectCarnet, AFieldsFileIsShownOnlyWhenItExists) {
    dialog.ShowFieldFile(frontEnd, Field::Carnet);
    dialog.ShowFieldFile(frontEnd, Field::CodeTable); // none named
    dialog.SetParamFile(dir / "absent.ini");
    dialog.ShowFieldFile(frontEnd, Field::ParamFile);
    EXPECT_EQ(frontEnd.shownFiles, std::vector<std::string>{dir / "carnet.gsi"});
}

// From a command line: the field book as the positional word, the values replacing the settings'.
TEST_F(LectCarnet, ACommandLineReplacesTheValuesOfTheSettings) {
    dialog.SetInstruments({{"Appareil Standard"}, {"TCR 307"}});
    frontEnd.dialogArguments = {
        dir / "carnet.gsi", "--geobase",  dir / "autre.geo", "--interpretation",  "1", "--table",
        dir / "job.cod",    "--appareil", "TCR 307",         "--ecrire-appareil", "1"};
    EXPECT_EQ(frontEnd.DoModal(dialog), DialogResult::Ok);
    EXPECT_TRUE(frontEnd.fileChoices.empty()); // the field book was named: nothing offered
    EXPECT_EQ(dialog.GeoBasePath(), dir / "autre.geo");
    EXPECT_TRUE(dialog.Interpret());
    EXPECT_EQ(dialog.CodeTablePath(), dir / "job.cod");
    EXPECT_EQ(dialog.InstrumentName(), "TCR 307");
    EXPECT_TRUE(dialog.WriteInstrument());

    ui::ScriptedFrontEnd refused;
    refused.dialogArguments = {"--appareil", "Disparu"};
    EXPECT_EQ(refused.DoModal(dialog), DialogResult::Failed);
    ASSERT_EQ(refused.messages.size(), 1u);
    EXPECT_EQ(refused.messages[0].text,
              "L'appareil « Disparu » n'est pas dans la liste des appareils des options.");
}
