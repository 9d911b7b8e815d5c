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
        dialog.SetCarnetFromSettings(dir / "carnet.gsi");
        dialog.SetParamFile(dir / "Wild.ini");
        dialog.SetInstruments({{"Appareil Standard"}, {"TCR 307"}});
    }
    TempDir dir;
    CParamFile params;
    CLectCarnet dialog;
    ui::ScriptedFrontEnd frontEnd;
};

} // namespace

TEST_F(LectCarnet, WhatTheDialogShows) {
    EXPECT_TRUE(dialog.GeoBaseFieldVisible());
    dialog.SetCreateNew(false);
    EXPECT_FALSE(dialog.GeoBaseFieldVisible());
    // The instrument combo and the code table follow their boxes.
    EXPECT_FALSE(dialog.InstrumentEnabled() || dialog.CodeTableEnabled());
    dialog.SetWriteInstrument(true);
    dialog.SetInterpret(true);
    EXPECT_TRUE(dialog.InstrumentEnabled() && dialog.CodeTableEnabled());
    // The instrument named by the settings, else the first of the list.
    dialog.SetInstrumentName("TCR 307");
    EXPECT_EQ(dialog.InstrumentIndex(), 1);
    dialog.SetInstrumentName("Disparu");
    EXPECT_EQ(dialog.InstrumentIndex(), 0);
    EXPECT_EQ(dialog.Choices().instrumentName, "Appareil Standard");
    // An empty "Carnet" key leaves the GéoBase empty until a field book is chosen beside which it is named.
    dialog.SetCarnetFromSettings("");
    EXPECT_EQ(dialog.GeoBasePath(), "");
    frontEnd.files = {dir / "levé.du.3.txt", std::nullopt}; // then the person cancels: nothing changes
    EXPECT_TRUE(dialog.BrowseCarnet(frontEnd));
    EXPECT_EQ(dialog.GeoBasePath(), dir / "levé.du.3.geo");
    EXPECT_FALSE(dialog.BrowseCarnet(frontEnd));
    EXPECT_EQ(dialog.Carnet(), dir / "levé.du.3.txt");
}

// The GéoBase is chosen to be created; the parameter file offered is the format's own: a delimited layout.
TEST_F(LectCarnet, TheBrowseButtonsOfferTheFilesOfTheirKind) {
    dialog.BrowseGeoBase(frontEnd);
    CLectCarnet(FieldBookFormat::Separateur, params, "").BrowseParamFile(frontEnd);
    ASSERT_EQ(frontEnd.fileChoices.size(), 2u);
    EXPECT_TRUE(frontEnd.fileChoices[0].save);
    EXPECT_EQ(frontEnd.fileChoices[0].defaultExtension, "geo");
    EXPECT_FALSE(frontEnd.fileChoices[1].save);
    EXPECT_EQ(frontEnd.fileChoices[1].defaultExtension, "sep");
}

// Each check in its order; a failure sends the person back to its field, a question answered No too.
TEST_F(LectCarnet, TheChecksOfOkInTheirOrder) {
    const auto wild = [&] {
        CLectCarnet d(FieldBookFormat::Wild, params, "");
        d.SetCarnetFromSettings(dir / "carnet.gsi");
        d.SetParamFile(dir / "Wild.ini");
        return d;
    };
    // OK pressed, with those answers: the result, the field to go back to, how many questions and
    // messages; their wording is the dialog's constants.
    const auto check = [&](CLectCarnet& d, std::vector<Answer> answers = {}) {
        ui::ScriptedFrontEnd fe;
        fe.answers.assign(answers.begin(), answers.end());
        const DialogResult result = d.OnOK(fe);
        return std::tuple(result, d.FocusField(), fe.questions.size() + 10 * fe.messages.size());
    };
    using std::tuple;
    auto d = wild();
    EXPECT_EQ(check(d), tuple(DialogResult::Ok, Field::None, 0u));
    d.SetParamFile(dir / "absent.ini");
    EXPECT_EQ(check(d), tuple(DialogResult::Failed, Field::ParamFile, 10u));
    auto interpreting = wild();
    interpreting.SetInterpret(true);
    EXPECT_EQ(check(interpreting, {Answer::No}), tuple(DialogResult::Cancel, Field::CodeTable, 1u));
    // Going on without the missing table reads the codes as they stand; the box stays ticked.
    interpreting.SetCodeTablePath("  " + dir / "absente.cod" + " ");
    EXPECT_EQ(check(interpreting, {Answer::Yes}), tuple(DialogResult::Ok, Field::None, 1u));
    EXPECT_TRUE(interpreting.NoCodeTable() && !interpreting.Choices().interpret && interpreting.Interpret());
    WriteBytes(dir / "Wild.ini", "[Parametrage]\nReferences=toutes\n");
    auto badSettings = wild();
    const auto [result, focus, said] = check(badSettings);
    EXPECT_EQ(tuple(result, focus), tuple(DialogResult::Failed, Field::CodeTable));
    EXPECT_NE(said, 0u);
    // The field book is checked first, whatever else is wrong.
    WriteBytes(dir / "carnet.geo", "");
    interpreting.SetCarnet(dir / "absent.gsi");
    EXPECT_EQ(check(interpreting), tuple(DialogResult::Failed, Field::Carnet, 10u));
    WriteBytes(dir / "Wild.ini", "[Parametrage]\n");
    auto existing = wild();
    EXPECT_EQ(check(existing, {Answer::No}), tuple(DialogResult::Cancel, Field::GeoBase, 1u));
    EXPECT_EQ(check(existing, {Answer::Yes}), tuple(DialogResult::Ok, Field::None, 1u));
    // The Quendal-Pc dialog has no parameter file to check.
    std::filesystem::remove(dir / "carnet.geo");
    CLecQuendal quendal(params, "");
    quendal.SetCarnetFromSettings(dir / "carnet.gsi");
    EXPECT_FALSE(quendal.HasParamFile());
    EXPECT_EQ(quendal.OnOK(frontEnd), DialogResult::Ok);
}

TEST_F(LectCarnet, EditingTheParametersAsksToCreateAMissingFileAndShowsIt) {
    dialog.ShowFieldFile(frontEnd, Field::Carnet);
    dialog.ShowFieldFile(frontEnd, Field::CodeTable); // none named: a file is shown only when it exists
    dialog.SetParamFile(dir / "Nouveau.ini");
    dialog.ShowFieldFile(frontEnd, Field::ParamFile);
    EXPECT_EQ(frontEnd.shownFiles, std::vector<std::string>{dir / "carnet.gsi"});
    frontEnd.answers = {Answer::No, Answer::Yes};
    EXPECT_FALSE(dialog.OnEditParams(frontEnd));
    EXPECT_EQ(dialog.FocusField(), Field::ParamFile);
    EXPECT_EQ(frontEnd.shownFiles.size(), 1u);
    EXPECT_TRUE(dialog.OnEditParams(frontEnd));
    EXPECT_EQ(frontEnd.questions.size(), 2u); // to create it, refused then accepted
    EXPECT_EQ(frontEnd.shownFiles, (std::vector<std::string>{dir / "carnet.gsi", dir / "Nouveau.ini"}));
    EXPECT_TRUE(CParamDriver("", dir / "Nouveau.ini", FieldBookFormat::Wild).Load(nullptr)); // reads back
    // The delimited layout is also recorded for the loading of points.
    CLectCarnet delimited(FieldBookFormat::Separateur, params, "");
    delimited.SetParamFile(dir / "Mon.sep");
    frontEnd.answers = {Answer::Yes};
    EXPECT_TRUE(delimited.OnEditParams(frontEnd));
    std::string recorded;
    params.ReadString("ChargementDeSemis", "ParametresSeparateur", "", recorded);
    EXPECT_EQ(recorded, dir / "Mon.sep");
}

// From a command line, an instrument that the list does not hold is refused by its name; what the other
// options replace is checked by the conversions that use them.
TEST_F(LectCarnet, ACommandLineNamingAnUnknownInstrumentIsRefused) {
    frontEnd.dialogArguments = {"--appareil", "Disparu"};
    EXPECT_EQ(frontEnd.DoModal(dialog), DialogResult::Failed);
    EXPECT_NE(MessageTexts(frontEnd).find("Disparu"), std::string::npos);
}
