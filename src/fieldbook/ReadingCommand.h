#pragma once

#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/LectCarnet.h"
#include "ui/Dialog.h"

namespace pyr {

// A reading command ("LecWild", "LQuenda" ...) run by the common flow of the commands: the conversion of a
// field book of its format into a new GéoBase. On a command line the field book is the positional word,
// "--geobase" the GéoBase to create, and the other options are those of the reading dialog, applied once
// the dialog holds the values of the settings.
class CFieldBookCommand : public ui::Dialog {
public:
    explicit CFieldBookCommand(FieldBookFormat format) : m_format(format) {}

    std::string GeoBaseHelp() const override;
    void DeclareOptions(ui::DialogOptions& options) override;
    ui::DialogResult Run(ui::FrontEnd& frontEnd) override;

private:
    FieldBookFormat m_format;
    ReadingRequests m_requests;
};

} // namespace pyr
