#pragma once

#include "ui/DialogModel.h"

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

// The face of a dialog that a front end runs: the options by which a command line drives it, and its run.
namespace pyr::ui {

class Form;
class FrontEnd;

// The options by which a dialog's values are set and its actions run from a command line. Each dialog
// only declares them; one mechanism (DialogCommandLine.h) parses them, applies them in the order they
// were given and writes the help.
class DialogOptions {
public:
    // Applies an option: an empty text when accepted, else the French reason of the refusal (shown
    // to the person, and the dialog is not run).
    using Apply = std::function<std::string(const std::string& value)>;
    // The same for an option that takes several values, given in their order.
    using ApplyValues = std::function<std::string(const std::vector<std::string>& values)>;

    struct Option {
        std::string name;      // long name without its dashes: "geobase"
        std::string valueName; // the value's name in the help ("FICHIER"); empty for a switch
        std::string help;      // one line of French
        bool repeatable = false;
        Apply apply;             // a switch, and an optional value not given, get an empty value
        bool optional = false;   // the value may be left out: "--listing" or "--listing FICHIER"
        int count = 1;           // the number of values of a value option: "--lecture FORMAT CARNET" has 2
        ApplyValues applyValues; // for an option of several values, instead of `apply`
    };

    // A word of the command line that is no option: "pyralis LecWild CARNET". Words are given to the
    // positional arguments in the order they are declared; each may be left out.
    struct PositionalArgument {
        std::string valueName; // "CARNET"
        std::string help;
        Apply apply;
    };

    // "--name VALUE".
    void Value(std::string name, std::string valueName, std::string help, Apply apply,
               bool repeatable = false);
    // "--name": a switch or an action.
    void Switch(std::string name, std::string help, std::function<std::string()> action);
    // "--name [VALUE]": an action that may be given a value (the value is empty when it is left out).
    void OptionalValue(std::string name, std::string valueName, std::string help, Apply apply);
    // "--name 0|1": a check box of the dialog; any other value is refused.
    void ZeroOrOne(std::string name, std::string help, std::function<void(bool)> set);
    // "--name VALUE1 VALUE2 ...": an option that takes several values, one name for each.
    void Values(std::string name, std::vector<std::string> valueNames, std::string help, ApplyValues apply);
    // "VALUE": the next word of the command line that is no option.
    void Positional(std::string valueName, std::string help, Apply apply);

    const std::vector<Option>& Options() const { return m_options; }
    const std::vector<PositionalArgument>& Positionals() const { return m_positionals; }

private:
    std::vector<Option> m_options;
    std::vector<PositionalArgument> m_positionals;
};

// A dialog as a front end runs it modally: the command's inputs, the options a command line may give it,
// and its run until it is closed. A dialog split from its model is a thin face that maps the options to
// the model's actions; the others are still their own model.
class Dialog : public DialogModel {
public:
    // The model the dialog shows: itself until it is split from it.
    virtual DialogModel& Model() { return *this; }
    // The help line of "--geobase" when the GéoBase means something else to the dialog (one to create);
    // "" for the common one.
    virtual std::string GeoBaseHelp() const { return {}; }
    // The dialog's own options; "--geobase" is common to every dialog and declared by the mechanism.
    virtual void DeclareOptions(DialogOptions&) {}
    // Runs the dialog with the person at the front end, after the options were applied: what the dialog
    // does until it is closed.
    virtual DialogResult Run(FrontEnd& frontEnd) = 0;
    // The dialog as a window shows it (Form.h), over the same model; null for a dialog that has no window
    // yet, which a desktop front end then runs as a command line would without options.
    virtual std::unique_ptr<Form> MakeForm();
};

} // namespace pyr::ui
