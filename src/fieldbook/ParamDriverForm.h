#pragma once

#include "fieldbook/ParamDriver.h"
#include "ui/Dialog.h"
#include "ui/Form.h"

#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pyr {

// The settings of a format's parameter file (its section "Parametrage") as a dialog of their own: what the
// field books of the format do not say (units, order of the coordinates, how references are told, the GSI
// station blocks, the layout of a delimited or columnar file). OK checks the values as a reading would
// check them and writes them into the file; a file that does not exist yet starts as a copy of the
// installation's, with its explanations. Cancel writes nothing. Without a window, the file is shown to be
// edited by hand.
class CDlgParamDriver : public ui::Dialog {
public:
    // `driver` names the file and the format; `installDir` holds the installation's Config folder.
    CDlgParamDriver(const CParamDriver& driver, std::string installDir, std::string formatName);

    std::string Caption() const override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    std::unique_ptr<ui::Form> MakeForm() override;

    // Reads the values of the file; of the installation's file when it does not exist yet, else the
    // defaults. A value is read as it stands, even one the reading would refuse: the person mends it here.
    void Read();
    const CParamDriver& Values() const { return m_values; }
    void Set(std::string_view key, std::string value) { m_values.SetText(key, std::move(value)); }
    // OK: "" when the values were written; else the French reason, shown, and nothing is written.
    std::string OnOK(ui::FrontEnd& frontEnd);

private:
    std::string InstalledFile() const;

    CParamDriver m_values;
    std::string m_installDir;
    std::string m_formatName;
};

// The window of the settings: a line for each key of the format, a drop-down list for a key that takes a
// few words, a check box for a switch, an edit for a text or a count; the file named at the top, with a
// button that shows it.
class CParamDriverForm : public ui::Form {
public:
    enum Id : int { kFileLabel = 3, kFile, kShowFile, kFirstKey = 10 }; // then a label and a control a key

    explicit CParamDriverForm(CDlgParamDriver& dialog);

    ui::DialogModel& Model() override { return m_dialog; }
    std::vector<ui::Control> Controls() const override;
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

    // The control of a key ("UniteAngles"), 0 when the format has none.
    int ControlOf(std::string_view key) const;

private:
    const CParamDriver::Key* KeyOf(int id) const;

    CDlgParamDriver& m_dialog;
};

} // namespace pyr
