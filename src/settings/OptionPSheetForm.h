#pragma once

#include "settings/OptionPages.h"
#include "ui/Form.h"

#include <string_view>
#include <vector>

namespace pyr {

// The window of the options sheet: one page per page of the sheet, in its order. A switch is a check box;
// a number or a text is an edit whose value the page checks when it is committed (a value refused is said
// in a message box, and the edit shows again the value the page holds); a set of switches kept as bits is
// a check list; a kind among a few is a drop-down list. The instruments page lists the instruments with
// their constants, and the one highlighted is edited below the list. OK writes every page; Cancel writes
// nothing.
class COptionPSheetForm : public ui::Form {
public:
    // The controls of the instruments page and of the columns of the radiated points; the controls of the
    // other keys are numbered from kFirstKeyControl in the order of the pages.
    enum Id : int {
        kInstrumentsLabel = 3,
        kInstruments,
        kAddInstrument,
        kRemoveInstrument,
        kInstrumentNameLabel,
        kInstrumentName,
        kInstrumentValues, // a label and an edit for each value of an instrument, in the order of the keys
        kExtraColumnLabel = kInstrumentValues + 12,
        kExtraColumn,
        kAddExtraColumn,
        kFirstKeyControl = 100
    };

    explicit COptionPSheetForm(COptionPSheet& sheet);

    ui::DialogModel& Model() override { return m_sheet; }
    std::vector<ui::Control> Controls() const override { return m_controls; }
    bool Open(ui::FrontEnd& frontEnd) override;
    ui::ControlState State(int id) const override;
    void Act(ui::FrontEnd& frontEnd, int id, const ui::Event& event) override;

    // The control that shows a key of a section (its edit, check box, list), 0 for none.
    int ControlOf(std::string_view section, std::string_view key) const;
    // The edit of a value of the instrument highlighted: "SigmaAh" gives its edit.
    static int InstrumentValueEdit(std::string_view prefix);

private:
    enum class Shows { Switch, Value, Bits, Choice };
    // What a control of a key shows.
    struct KeyControl {
        int id = 0;
        int page = 0; // its rank in the sheet
        std::string_view key;
        Shows shows = Shows::Value;
        std::vector<std::string> items; // the lines of a check list or a drop-down list
    };

    void Build();
    const KeyControl* Find(int id) const;
    // The value of a key as its edit shows it.
    static std::string EditText(const COptionPage& page, std::string_view key);
    COptionPage& PageOf(const KeyControl& control) const;
    void ActOnKey(ui::FrontEnd& frontEnd, const KeyControl& control, const ui::Event& event);
    void ActOnInstruments(ui::FrontEnd& frontEnd, int id, const ui::Event& event);
    // A value typed for a key: refused, the reason is shown and the focus stays on the edit.
    void SetTyped(ui::FrontEnd& frontEnd, COptionPage& page, const std::string& key, const std::string& text,
                  int id);
    int Instrument() const; // the instrument highlighted, within the list

    COptionPSheet& m_sheet;
    std::vector<ui::Control> m_controls;
    std::vector<KeyControl> m_keys;
    int m_instrument = 0;  // the line highlighted in the list of instruments
    int m_extraColumn = 0; // the column offered to be added to the radiated points
};

} // namespace pyr
