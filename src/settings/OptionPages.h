#pragma once

#include "settings/CalcOptions.h"
#include "settings/OptionInstruments.h"
#include "ui/Dialog.h"

#include <array>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

// The options sheet and its eight pages. Each page holds the values of its section: it reads them all
// (each with its default, brought within its limits) and writes them all back when the sheet is closed
// with OK. The computations do not go through the pages: they read the same keys with the functions of
// CalcOptions.h and ReadInstruments.
namespace pyr {

// One value of a page.
struct OptionValue {
    const OptionEntry* entry = nullptr;
    int integer = 0;  // switches and integers
    double real = 0;  // reals
    std::string text; // texts
};

// A number typed by a person for a key of that kind (switch, integer or real), read strictly and checked
// against the limits: empty when accepted (the number in `value`), else the French reason.
std::string CheckOptionNumber(std::string_view section, std::string_view key, std::string_view text,
                              OptionType type, double minimum, double maximum, double& value);

class COptionPage {
public:
    virtual ~COptionPage() = default;

    // The page's section; a page may also hold the keys of another (the listings page holds the layout
    // of the listings), each key then written in its own section.
    std::string_view Section() const { return m_section; }
    bool Holds(std::string_view section) const;
    // The section a key of the page lives in (the page's own for a key it does not know).
    std::string_view SectionOf(std::string_view key) const;

    // Reads every key of the page from the parameter path.
    virtual void Read(std::string_view paramPath);
    // Writes every key: switches and integers "%d", reals "%f", texts as they are. True when all were
    // stored (a failure has been reported by the store).
    virtual bool Write(std::string_view paramPath) const;
    // The page as an initialisation file shows it: "[Section]", then one "Clé=valeur" line per key.
    virtual std::vector<std::string> Lines() const;

    // A value typed by a person for that key: empty when accepted and held, else the French reason of
    // the refusal (unknown key, not a number, out of the limits), the page being left as it was.
    virtual std::string Set(std::string_view key, std::string_view text);
    // Writes only that key (and what goes with it), as Write would. `key` is a key accepted by Set.
    virtual bool WriteKey(std::string_view paramPath, std::string_view key) const;
    // The key as the page names it, and its value as it is written ("6378.000000"): after Set.
    virtual std::pair<std::string, std::string> KeyAndValue(std::string_view key) const;

    // The values, for the front ends and the computations' tests. An unknown key gives 0 or "".
    bool Switch(std::string_view key) const { return Int(key) != 0; }
    int Int(std::string_view key) const;
    double Real(std::string_view key) const;
    const std::string& Text(std::string_view key) const;
    // A widget's value: brought within the key's limits.
    void SetSwitch(std::string_view key, bool on) { SetInt(key, on ? 1 : 0); }
    void SetInt(std::string_view key, int value);
    void SetReal(std::string_view key, double value);
    void SetText(std::string_view key, std::string value);

protected:
    explicit COptionPage(std::string_view section);
    // The keys of another section of the table, after those of the page's own.
    void AddSection(std::string_view section);

private:
    const OptionValue* Find(std::string_view key) const;
    OptionValue* Find(std::string_view key);

    std::string_view m_section;
    std::vector<std::string_view> m_otherSections;
    std::vector<OptionValue> m_values; // in the order of the table, section by section
};

// Instruments. The list, numbered from 0, always starts with "Appareil Standard" (OptionInstruments.h).
class CPagOptionAppareil : public COptionPage {
public:
    CPagOptionAppareil() : COptionPage(kSectionInstruments) {}

    void Read(std::string_view paramPath) override;
    bool Write(std::string_view paramPath) const override;
    std::vector<std::string> Lines() const override;
    // "Appareil%d" names an instrument of the list or, with the number that follows the last one, adds
    // one; the other numbered keys set a value of an instrument of the list. The standard instrument
    // keeps its name.
    std::string Set(std::string_view key, std::string_view text) override;
    // A name writes the whole group of that instrument, and ends the list after a new last one.
    bool WriteKey(std::string_view paramPath, std::string_view key) const override;
    std::pair<std::string, std::string> KeyAndValue(std::string_view key) const override;

    const std::vector<InstrumentOptions>& Instruments() const { return m_instruments; }
    // Adds an instrument with null constants at the end of the list: its number, or -1 for an empty name.
    int AddInstrument(std::string name);
    // Removes an instrument; the standard one (number 0) stays. False when nothing was removed.
    bool RemoveInstrument(int number);
    // New values for an instrument of the list, brought within their limits; the standard one keeps its
    // name.
    void SetInstrument(int number, InstrumentOptions values);

private:
    std::vector<InstrumentOptions> m_instruments{InstrumentOptions{kStandardInstrument}};
};

class CPagOptionCalcul : public COptionPage {
public:
    CPagOptionCalcul() : COptionPage(kSectionCalculations) {}
};

class CPagOptionCorrect : public COptionPage {
public:
    CPagOptionCorrect() : COptionPage(kSectionCorrections) {}
};

// Editor: its decimals set those of the store once the sheet has read or written them.
class CPagOptionEditor : public COptionPage {
public:
    CPagOptionEditor() : COptionPage(kSectionEditor) {}
};

class CPagOptionLinkDB : public COptionPage {
public:
    CPagOptionLinkDB() : COptionPage(kSectionDatabase) {}
};

// Listings: "RayonContenu" lists the columns of the radiated-points listing. The page also holds the
// layout of the listings, in its own section "Listings": the format, the page's length and width.
class CPagOptionListing : public COptionPage {
public:
    CPagOptionListing();

    // The columns offered besides N, X, Y, Z, GI and DH.
    static constexpr std::array<const char*, 5> kExtraColumns = {"HP", "AH", "AV", "DI", "CS"};
    // Appends "," and the column to "RayonContenu".
    void AddRadiatedColumn(std::string_view column);
};

class CPagOptionNivel : public COptionPage {
public:
    CPagOptionNivel() : COptionPage(kSectionLevelling) {}
};

class CPagOptionToler : public COptionPage {
public:
    CPagOptionToler() : COptionPage(kSectionTolerances) {}
};

// The options sheet of the command "CalcOpt". Its pages are read from the parameter path of its inputs
// the first time they are needed (an option of the command line, or Run), and the store's decimals and
// axis order then follow the file. OK writes every page; Cancel writes nothing.
//
// On a command line: "--regler Section/Clé=valeur" (repeatable) sets a value as its page would take it
// from a person; a refused value stops the command before anything is written. Run writes only the keys
// so set, each as OK writes it, and says so in the text window; "--afficher", or no option at all, lists
// every section and key with its value in the text window.
class COptionPSheet : public ui::Dialog {
public:
    std::string Caption() const override;
    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;
    // The sheet as a window: OptionPSheetForm.h.
    std::unique_ptr<ui::Form> MakeForm() override;

    // The pages in their order.
    std::array<COptionPage*, 8> Pages();
    CPagOptionAppareil& Appareil() { return Loaded(m_appareil); }
    CPagOptionCalcul& Calcul() { return Loaded(m_calcul); }
    CPagOptionCorrect& Correct() { return Loaded(m_correct); }
    CPagOptionEditor& Editor() { return Loaded(m_editor); }
    CPagOptionLinkDB& LinkDB() { return Loaded(m_linkDB); }
    CPagOptionListing& Listing() { return Loaded(m_listing); }
    CPagOptionNivel& Nivel() { return Loaded(m_nivel); }
    CPagOptionToler& Toler() { return Loaded(m_toler); }

    // OK: every page writes all its keys, then the store follows the editor and listing options. True
    // when every value was stored.
    bool OnOK();
    // Cancel: nothing is written.
    void OnCancel() {}

    // "Section/Clé=valeur", as "--regler" gives it: empty when accepted, else the French reason.
    std::string Regler(std::string_view setting);
    // Every section with its keys and values, an empty line between sections.
    std::vector<std::string> Lines();

private:
    template <class Page>
    Page& Loaded(Page& page) {
        Load();
        return page;
    }
    void Load();
    COptionPage* FindPage(std::string_view section);

    CPagOptionAppareil m_appareil;
    CPagOptionCalcul m_calcul;
    CPagOptionCorrect m_correct;
    CPagOptionEditor m_editor;
    CPagOptionLinkDB m_linkDB;
    CPagOptionListing m_listing;
    CPagOptionNivel m_nivel;
    CPagOptionToler m_toler;
    bool m_loaded = false;

    // The keys set from the command line, each once, in the order first given: section and key.
    std::vector<std::pair<std::string, std::string>> m_settings;
    bool m_show = false;
};

} // namespace pyr
