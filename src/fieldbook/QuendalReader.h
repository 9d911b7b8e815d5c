#pragma once

#include "fieldbook/FieldBookReader.h"
#include "fieldbook/QuendalFormat.h"

namespace pyr {

// The reader of Quendal-Pc field books (QuendalFormat.h, docs/quendal-pc.md): every record gives back
// the element it was written from. Stations, sightings and points go through the store's checks; a CODE
// record is a field code, interpreted through the code table when asked.
class CQuendalReader : public CFieldBookReader {
protected:
    void ReadLine(std::string_view line, int number) override;

private:
    // A number of the record, kUndefined when the field is empty; false, the line reported, when the
    // field is no number.
    bool Number(std::size_t field, int line, double& value);
    bool Name(std::size_t field, int line, const char* datum, std::string& name);
    void ExtraFields(int line, std::size_t expected);

    void ReadInstrument(int line);
    void ReadStation(int line);
    void ReadSighting(int line, bool reference);
    void ReadPoint(int line);
    void ReadLevelling(int line, bool back);
    void ReadTraverse(std::string_view text, int line);
    void ReadCode(int line, bool interpreted);
    void ReadComment(std::string_view text, int line);

    qdl::Fields m_fields;
    std::string m_scratch;
};

} // namespace pyr
