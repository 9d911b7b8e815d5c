// The reading dialog and the format's settings as windows: what the person types, ticks and presses goes
// to the dialog; its checks keep it open on the field they name; a reading through it gives what the
// command line gives.
#include "FieldBookTestSupport.h"
#include "fieldbook/FieldBookConverter.h"
#include "fieldbook/LectCarnetForm.h"
#include "fieldbook/ParamDriverForm.h"

#include <deque>
#include <filesystem>
#include <functional>
#include <gtest/gtest.h>
#include <set>

using namespace pyr;
using ui::DialogResult;
using ui::EventKind;
using Form = CLectCarnetForm;
namespace fs = std::filesystem;

namespace {

// A front end that shows a dialog's window and plays a script on it, as a person would; a dialog with no
// script left is run as a command line.
class WindowFrontEnd : public ui::ScriptedFrontEnd {
public:
    std::deque<std::function<void(ui::Form&)>> scripts;

    DialogResult DoModal(ui::Dialog& dialog) override {
        std::unique_ptr<ui::Form> form = dialog.MakeForm();
        if (!form || scripts.empty()) return ScriptedFrontEnd::DoModal(dialog);
        dialogs.push_back(form->Caption());
        auto script = std::move(scripts.front());
        scripts.pop_front();
        if (!form->Open(*this)) return DialogResult::Cancel;
        script(*form);
        return form->Ended().value_or(DialogResult::Cancel);
    }
};

void Type(ui::FrontEnd& frontEnd, ui::Form& form, int id, const std::string& text) {
    form.Act(frontEnd, id, {EventKind::Text, -1, false, text});
}

class ReadingForm : public ::testing::Test {
protected:
    ReadingForm() {
        fs::create_directories(install + "Config");
        fs::copy_file(std::string(PYR_SOURCE_DIR) + "/data/Config/Wild.ini", install + "Config/Wild.ini");
        fs::copy_file(FieldBookData("wild-gsi16-84.gsi"), dir / "leve.gsi");
    }
    DialogResult Convert(FieldBookFormat format = FieldBookFormat::Wild) {
        FieldBookConverter converter(format, &frontEnd, dir / "Pyralis.ini", install, &txt);
        return RunConversion(converter);
    }

    TempDir dir;
    std::string install = dir / "installation/";
    ScopedEnv registry{"PYRALIS_REGISTRE", dir / "registre"};
    WindowFrontEnd frontEnd;
    CPyrTxtWnd txt{frontEnd};
};

} // namespace

TEST_F(ReadingForm, OkWithAMissingFieldBookKeepsTheDialogOpenOnTheFieldBook) {
    frontEnd.scripts.push_back([this](ui::Form& form) {
        EXPECT_TRUE(form.State(Form::kGeoBase).visible && form.State(Form::kEditParams).visible);
        EXPECT_FALSE(form.State(Form::kCodeTable).enabled || form.State(Form::kInstrument).enabled);
        EXPECT_EQ(form.State(Form::kParamFile).text, install + "Config/Wild.ini");
        Type(frontEnd, form, Form::kCarnet, dir / "absent.gsi");
        EXPECT_EQ(form.State(Form::kGeoBase).text, dir / "absent.geo"); // named after the field book
        form.Act(frontEnd, ui::kIdOk, {});
        EXPECT_FALSE(form.Ended());
        EXPECT_EQ(form.FocusRequest(), Form::kCarnet);
        form.Act(frontEnd, ui::kIdCancel, {});
    });
    EXPECT_EQ(Convert(), DialogResult::Cancel);
    EXPECT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_FALSE(fs::exists(dir / "absent.geo"));

    // Quendal-Pc has no parameter file; merged into the editor's GéoBase, there is none to create.
    CParamFile params(dir / "Pyralis.ini");
    CLecQuendal quendal(params, install);
    quendal.SetCreateNew(false);
    const auto form = quendal.MakeForm();
    for (int id :
         {Form::kParamFile, Form::kBrowseParamFile, Form::kEditParams, Form::kGeoBase, Form::kGeoBaseLabel})
        EXPECT_FALSE(form->State(id).visible) << id;
}

TEST_F(ReadingForm, AReadingThroughTheWindowGivesTheGeoBaseOfTheCommandLine) {
    frontEnd.dialogArguments = {dir / "leve.gsi", "--geobase", dir / "ligne.geo"};
    ASSERT_EQ(Convert(), DialogResult::Ok) << MessageTexts(frontEnd);
    ASSERT_NE(ReadBytes(dir / "ligne.geo").find("\n1003\t"), std::string::npos);

    frontEnd.dialogArguments.clear();
    frontEnd.scripts.push_back([this](ui::Form& form) {
        form.Act(frontEnd, Form::kBrowseCarnet, {}); // the last field book is offered
        EXPECT_EQ(form.State(Form::kCarnet).text, dir / "leve.gsi");
        Type(frontEnd, form, Form::kGeoBase, dir / "fenetre.geo");
        form.Act(frontEnd, ui::kIdOk, {});
    });
    ASSERT_EQ(Convert(), DialogResult::Ok) << MessageTexts(frontEnd);
    EXPECT_EQ(ReadBytes(dir / "fenetre.geo"), ReadBytes(dir / "ligne.geo"));
}

// "Paramètres..." opens the format's settings: a new file starts as the installation's, with the values
// chosen; the reading then takes them.
TEST_F(ReadingForm, TheFormatsSettingsAreChosenInADialogOfTheirOwn) {
    const std::string file = dir / "mes-reglages.ini";
    frontEnd.answers = {ui::Answer::Yes}; // create it
    frontEnd.scripts.push_back([&](ui::Form& form) {
        Type(frontEnd, form, Form::kCarnet, dir / "leve.gsi");
        Type(frontEnd, form, Form::kParamFile, file);
        form.Act(frontEnd, Form::kEditParams, {});
        form.Act(frontEnd, ui::kIdOk, {});
    });
    frontEnd.scripts.push_back([&](ui::Form& form) {
        auto& settings = static_cast<CParamDriverForm&>(form);
        EXPECT_EQ(form.State(settings.ControlOf(kKeyUniteAngles)).current, 0);
        form.Act(frontEnd, settings.ControlOf(kKeyUniteAngles), {EventKind::Select, 1, false, {}});
        form.Act(frontEnd, settings.ControlOf(kKeyPointsCalcules), {EventKind::Check, -1, true, {}});
        Type(frontEnd, form, settings.ControlOf(kKeyCodesStation), " 2, 21, 7 ");
        form.Act(frontEnd, ui::kIdOk, {});
        EXPECT_EQ(form.Ended(), DialogResult::Ok);
    });
    ASSERT_EQ(Convert(), DialogResult::Ok) << MessageTexts(frontEnd);
    EXPECT_EQ(frontEnd.questions.size(), 1u); // to create the file
    const std::string written = ReadBytes(file);
    for (const char* line : {"; Paramètres de lecture des carnets Wild", "UniteAngles=degres\n",
                             "PointsCalcules=1\n", "CodesStation=2, 21, 7\n"})
        EXPECT_NE(written.find(line), std::string::npos) << line << "\n" << written;

    // A layout the reading would refuse is said, and nothing is written.
    CParamDriver layout("", dir / "mon.sep", FieldBookFormat::Separateur);
    CDlgParamDriver dialog(layout, install, "Séparateur");
    auto form = dialog.MakeForm();
    auto& settings = static_cast<CParamDriverForm&>(*form);
    ASSERT_TRUE(form->Open(frontEnd));
    Type(frontEnd, *form, settings.ControlOf(kKeyChampsVisee), "TYPE,HP,AH");
    frontEnd.messages.clear();
    form->Act(frontEnd, ui::kIdOk, {});
    EXPECT_FALSE(form->Ended());
    EXPECT_EQ(frontEnd.messages.size(), 1u);
    EXPECT_FALSE(fs::exists(dir / "mon.sep"));
}

// Every key of every format has a label, in the dialog's grid, and each label's accelerator is its own in its
// dialog.
TEST_F(ReadingForm, EverySettingHasALabelWithAnAcceleratorOfItsOwn) {
    for (const auto& info : FieldBookFormats()) {
        if (!info.parameterFile) continue;
        CDlgParamDriver dialog(CParamDriver("", "", info.format), "", info.name);
        std::set<char> accelerators;
        for (const auto& control : dialog.MakeForm()->Controls()) {
            EXPECT_TRUE(control.row >= 0 && control.column >= 0) << info.name << " : " << control.name;
            const std::size_t amp = control.text.find('&');
            const bool labelled =
                control.kind == ui::ControlKind::Label || control.kind == ui::ControlKind::Check;
            EXPECT_TRUE(!labelled || control.id == CParamDriverForm::kFileLabel || amp != std::string::npos)
                << info.name << " : " << control.text;
            const char letter =
                amp == std::string::npos ? '\0' : static_cast<char>(std::tolower(control.text[amp + 1]));
            EXPECT_TRUE(letter == '\0' || accelerators.insert(letter).second)
                << info.name << " : " << control.text;
        }
    }
}
