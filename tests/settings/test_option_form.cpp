// The options sheet as a window: values typed, ticked and chosen on its pages are what the pages hold and
// what OK writes; the listings' layout is one of its settings, on its page and on the command line.
#include "SettingsTestSupport.h"
#include "settings/ListingObject.h"
#include "settings/OptionPSheetForm.h"
#include "settings/OptionPages.h"

#include <map>

namespace pyr {
namespace {

using ui::Event;
using ui::EventKind;
using Form = COptionPSheetForm;

class OptionForm : public test::SettingsTest {
protected:
    std::unique_ptr<COptionPSheet> Sheet() const {
        auto sheet = std::make_unique<COptionPSheet>();
        sheet->SetInputs({"", path, "", "options des calculs topométriques."});
        return sheet;
    }
    void Type(Form& form, int id, std::string text) {
        form.Act(frontEnd, id, {EventKind::Text, -1, false, text});
    }

    static constexpr const char* kHandKept =
        "; réglages du cabinet\n[Options_Corrections]\nProjection=CC48\n";
};

TEST_F(OptionForm, WhatIsTypedThenOkWritesTheFileThatThePagesWouldWrite) {
    WriteBytes(path, kHandKept);
    auto sheet = Sheet();
    auto made = sheet->MakeForm();
    auto& form = static_cast<Form&>(*made);
    ASSERT_TRUE(form.Open(frontEnd));
    Type(form, form.ControlOf("Options_Corrections", "RayonTerre"), "6378.5");
    form.Act(frontEnd, form.ControlOf("Options_Calculs", "Cheminements"),
             {EventKind::CheckLine, 0, true, {}});
    form.Act(frontEnd, form.ControlOf("Options_Listings", "Inverser_XY"), {EventKind::Check, -1, true, {}});
    form.Act(frontEnd, form.ControlOf("Listings", "Format"), {EventKind::Select, 0, false, {}});
    Type(form, form.ControlOf("Listings", "LongueurPage"), "60");
    form.Act(frontEnd, Form::kExtraColumn, {EventKind::Select, 3, false, {}});
    form.Act(frontEnd, Form::kAddExtraColumn, {});
    form.Act(frontEnd, Form::kAddInstrument, {});
    EXPECT_EQ(form.FocusRequest(), Form::kInstrumentName);
    Type(form, Form::kInstrumentName, "TC 1800");
    Type(form, Form::InstrumentValueEdit("SigmaAh"), "0.0003");
    EXPECT_EQ(form.State(Form::kInstruments).items.at(1), "1\tTC 1800\t0\t0\t0.0003\t0\t0\t0");
    EXPECT_EQ(ReadBytes(path), kHandKept); // nothing is written before OK
    form.Act(frontEnd, ui::kIdOk, {});
    ASSERT_EQ(form.Ended(), ui::DialogResult::Ok);
    EXPECT_TRUE(frontEnd.messages.empty());
    const std::string byForm = ReadBytes(path);

    WriteBytes(path, kHandKept);
    auto bySet = Sheet();
    for (const char* setting :
         {"Options_Corrections/RayonTerre=6378.5", "Options_Calculs/Cheminements=33",
          "Options_Listings/Inverser_XY=1", "Listings/Format=0", "Listings/LongueurPage=60",
          "Définitions_Des_Appareils/Appareil1=TC 1800", "Définitions_Des_Appareils/SigmaAh1=0.0003"})
        ASSERT_EQ(bySet->Regler(setting), "") << setting;
    bySet->Listing().AddRadiatedColumn("DI");
    ASSERT_TRUE(bySet->OnOK());
    EXPECT_EQ(byForm, ReadBytes(path));

    // The listings follow the layout chosen on the page.
    CDlgCfgListing listing(frontEnd);
    listing.ReadLastParameters(path);
    EXPECT_TRUE(listing.IsRichText());
    EXPECT_EQ(listing.GetPageLength(), 60);
}

TEST_F(OptionForm, ARefusedValueIsSaidAndTheFieldKeepsItsValueAndCancelWritesNothing) {
    auto sheet = Sheet();
    auto form = sheet->MakeForm();
    ASSERT_TRUE(form->Open(frontEnd));
    auto& sheetForm = static_cast<Form&>(*form);
    const int radius = sheetForm.ControlOf("Options_Corrections", "RayonTerre");
    for (const char* typed : {"5000", "6378,5"}) {
        Type(sheetForm, radius, typed);
        EXPECT_EQ(form->State(radius).text, "6366") << typed;
        EXPECT_EQ(form->FocusRequest(), radius) << typed;
    }
    EXPECT_EQ(Texts(frontEnd, ui::kIconWarning),
              (std::vector<std::string>{
                  "Options_Corrections/RayonTerre : la valeur 5000 est hors des limites (6000 à 7000).",
                  "Options_Corrections/RayonTerre : la valeur « 6378,5 » n'est pas un nombre."}));
    // The standard instrument keeps its name and stays in the list.
    EXPECT_FALSE(form->State(Form::kInstrumentName).enabled);
    EXPECT_FALSE(form->State(Form::kRemoveInstrument).enabled);

    Type(sheetForm, radius, "6400");
    form->Act(frontEnd, ui::kIdCancel, {});
    EXPECT_EQ(form->Ended(), ui::DialogResult::Cancel);
    EXPECT_FALSE(std::filesystem::exists(path));
}

// Every key has its control, every field a label whose accelerator is its own on its page: the pages are
// shown one at a time.
TEST_F(OptionForm, EveryKeyHasAFieldWithALabelAndAnAcceleratorOfItsOwnOnItsPage) {
    auto sheet = Sheet();
    auto form = sheet->MakeForm();
    for (const auto& entry : CalcOptionTable())
        EXPECT_NE(static_cast<Form&>(*form).ControlOf(entry.section, entry.key), 0) << entry.key;
    const auto controls = form->Controls();
    std::map<int, int> parentOf;
    std::map<int, int> labelled; // a field and its label
    for (const auto& control : controls) {
        parentOf[control.id] = control.parent;
        if (control.kind == ui::ControlKind::Label) labelled[control.buddy] = control.id;
    }
    const auto pageOf = [&](int id) {
        while (parentOf.count(id) && parentOf[id] > 0 && parentOf[parentOf[id]] != 0)
            id = parentOf[id];
        return parentOf[id];
    };
    std::map<int, std::map<int, std::string>> accelerators; // by page
    for (const auto& control : controls) {
        using enum ui::ControlKind;
        const bool field = control.kind == Edit || control.kind == Combo || control.kind == List ||
                           control.kind == CheckList;
        EXPECT_TRUE(!field || labelled.count(control.id)) << control.name;
        const std::size_t amp = control.text.find('&');
        if (control.kind == Page || control.kind == Group) continue;
        if (amp == std::string::npos) {
            EXPECT_TRUE((control.kind != Label && control.kind != Check && control.kind != Button) ||
                        control.parent == ui::kButtonRow)
                << control.name << " sans raccourci";
            continue;
        }
        const int letter = std::tolower(static_cast<unsigned char>(control.text[amp + 1]));
        auto [previous, added] = accelerators[pageOf(control.id)].emplace(letter, control.text);
        EXPECT_TRUE(added) << control.text << " / " << previous->second;
    }
}

TEST_F(OptionForm, TheListingsLayoutIsSetAndShownOnTheCommandLineLikeEveryKey) {
    frontEnd.dialogArguments = {"--regler", "Listings/Format=0", "--regler", "listings/largeurpage=132",
                                "--afficher"};
    auto sheet = Sheet();
    EXPECT_EQ(frontEnd.DoModal(*sheet), ui::DialogResult::Ok);
    EXPECT_EQ(ReadBytes(path), "[Listings]\nFormat=0\nLargeurPage=132\n");
    EXPECT_NE(frontEnd.AllLines().find("\n[Listings]\nFormat=0\nLongueurPage=70\nLargeurPage=132\n"),
              std::string::npos)
        << frontEnd.AllLines();

    // Each key in its own section, and within its limits.
    for (const auto& [setting, reason] : std::vector<std::pair<std::string, std::string>>{
             {"Options_Listings/Format=1", "Options_Listings/Format : clé inconnue dans cette section."},
             {"Listings/Inverser_XY=1", "Listings/Inverser_XY : clé inconnue dans cette section."},
             {"Listings/Format=3", "Listings/Format : la valeur 3 est hors des limites (0 à 2)."}})
        EXPECT_EQ(Sheet()->Regler(setting), reason);
}

} // namespace
} // namespace pyr
