#pragma once

#include "fieldbook/FieldBookFormats.h"
#include "geobase/Carnet.h"
#include "settings/OptionInstruments.h"
#include "settings/ParamStore.h"
#include "ui/Dialog.h"

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace pyr {

class CFieldBookReader;
class CLectCarnet;
class CPyrTxtWnd;
class CTableCode;

// The GéoBase open in the GéoBase editor, as a conversion sees it: the code table the editor holds (or
// none) and the instruments of its options.
struct EditorDocument {
    CTableCode* codeTable = nullptr;
    std::vector<InstrumentOptions> instruments;
};

// The context of one conversion of a field book, built by its caller (a reading command, or the editor's
// reading menu).
class FieldBookConverter {
public:
    FieldBookConverter(FieldBookFormat format, ui::FrontEnd* parent, std::string paramPath,
                       std::string installDir, CPyrTxtWnd* txt, EditorDocument* document = nullptr);
    ~FieldBookConverter();

    FieldBookFormat format;
    ui::FrontEnd* parent;                   // owner of the message boxes (null: the application's)
    CCarnet result;                         // the elements read, in reading order
    CParamFile registry{kRegistrySettings}; // the registry settings: the last file written
    CParamFile params;                      // the current parameter file: every key of the format
    EditorDocument* document;               // null when the command runs from the drawing
    std::string installDir;                 // the folder under which Config lies
    CPyrTxtWnd* txt;                        // progress and line errors (null: nothing printed)
    CTableCode* codeTable = nullptr;        // borrowed from the document, or ownedTable
    std::unique_ptr<CTableCode> ownedTable;

    // How the reading dialog is shown: by the front end (its DoModal), unless the caller gives its own
    // way (a command that holds the options of its command line).
    std::function<ui::DialogResult(CLectCarnet&)> showDialog;
    // The format's reader: MakeFieldBookReader unless the caller gives another.
    std::function<std::unique_ptr<CFieldBookReader>()> makeReader;

    ui::FrontEnd& FrontEnd() const;
    // The GéoBase written by the last conversion without a target ("" when none was).
    const std::string& Written() const { return m_written; }

private:
    friend ui::DialogResult RunConversion(FieldBookConverter& converter, CCarnet* target);
    std::string m_written;
};

// Runs a conversion: reads the format's settings, shows the reading dialog, writes the settings back,
// reads the field book, and then either appends what was read to `target` (the GéoBase open in the editor;
// nothing is written to disk) or, without a target, writes a new GéoBase and records it as the last file.
// Ok when the elements went where they should; Cancel when the person stopped; Failed when a message said
// why it could not be done. A conversion stopped before the reading leaves the target and the disk as they
// were. A field book from which no element is read is a failure that says so: nothing is appended to the
// target, no existing file is replaced (a new empty GéoBase is written only where there was no file), and
// no last file is recorded.
ui::DialogResult RunConversion(FieldBookConverter& converter, CCarnet* target = nullptr);

// Whether a reference (1002) or measured sighting (1003) has a prism height of exactly 0.
bool HasZeroPrismHeight(const CCarnet& carnet);

// Writes a new GéoBase at `path` whole (through a temporary file beside it, renamed over it, with the
// access rights of the file it replaces). 0, or the system error when it cannot be written: then nothing
// is left at `path` that was not there, and a file that was there is as it was.
int WriteNewGeoBase(const CCarnet& carnet, const std::string& path);

} // namespace pyr
