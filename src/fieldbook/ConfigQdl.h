#pragma once

#include "fieldbook/PointExport.h"

#include <string>

namespace pyr {

class CCarnet;
namespace ui {
class FrontEnd;
}

// What an export writes: the points (kind 1006), the field-book observations (every other element), or
// both.
struct QdlExportChoices {
    bool points = true;
    bool observations = true;
};

// The Quendal-Pc configuration: the writer of Quendal-Pc field books (QuendalFormat.h). Its input is a
// list of records: the elements of a GéoBase, or those that the delimited and columnar importers build
// from their files (unchecked elements, their codes as uninterpreted commands of kind 1009, which the
// Quendal reader then interprets).
class CDlgConfigQdl {
public:
    // Writes the records to `path`, opened in `mode`: "w" replaces the file, "a" completes it (the header
    // line is written only at the start of a file). False when the file cannot be written: the message
    // is shown on `parent` (else the application's front end).
    static bool Export(const CCarnet& records, const std::string& path, const char* mode = "w",
                       QdlExportChoices choices = {}, ui::FrontEnd* parent = nullptr);
    // Writes the elements of the job's scope in its GéoBase to the job's file, replaced or
    // completed (the header line heads a new or empty file only), whole or not at all. `written`, when
    // given, receives the number of elements written. False when the file cannot be written (the
    // message said why).
    static bool Export(const PointExportJob& job, QdlExportChoices choices, int* written = nullptr);
    // The text of the field book, header line first when asked.
    static std::string Text(const CCarnet& records, QdlExportChoices choices = {}, bool header = true);
};

} // namespace pyr
