#include "fieldbook/ReadingCommand.h"

#include "fieldbook/FieldBookConverter.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

namespace pyr {

std::string CFieldBookCommand::GeoBaseHelp() const {
    return "la GéoBase à créer (par défaut le carnet avec l'extension .geo, à côté de lui)";
}

void CFieldBookCommand::DeclareOptions(ui::DialogOptions& options) {
    DeclareReadingOptions(options, m_requests, FormatInfo(m_format).parameterFile != nullptr);
}

ui::DialogResult CFieldBookCommand::Run(ui::FrontEnd& frontEnd) {
    CPyrTxtWnd txt(frontEnd);
    FieldBookConverter converter(m_format, &frontEnd, Inputs().paramPath, Inputs().configFolder, &txt);
    ReadingRequests requests = m_requests;
    if (GeoBaseNamed()) requests.geoBase = GeoBase();
    // The reading dialog is run by the front end: a window shows it, a command line applies to it the
    // options this command was given, the same as its own.
    converter.showDialog = [&frontEnd, &requests](CLectCarnet& dialog) {
        dialog.SetRequests(requests);
        return frontEnd.DoModal(dialog);
    };
    return RunConversion(converter, nullptr);
}

} // namespace pyr
