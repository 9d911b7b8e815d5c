#include "fieldbook/LectGeodimRecords.h"

#include "core/Strings.h"

#include <charconv>
#include <string>

namespace pyr::gdm {

namespace {

// Labels run from 0 to a few hundred; more digits than this is no label.
constexpr std::size_t kMaxLabelDigits = 4;

bool ReadLabel(std::string_view text, int& label) {
    if (text.empty() || text.size() > kMaxLabelDigits) return false;
    for (char c : text)
        if (c < '0' || c > '9') return false;
    std::from_chars(text.data(), text.data() + text.size(), label);
    return true;
}

} // namespace

bool IsTextLabel(int label) {
    return label == 0 || label == 1 || label == 4 || (label >= 50 && label <= 56);
}

RecordShape SplitRecord(std::string_view line, Record& record) {
    line = TrimmedOfControls(line);
    if (line.empty()) return RecordShape::Blank;
    const std::size_t equal = line.find('=');
    if (!ReadLabel(TrimmedOfControls(line.substr(0, equal)), record.label)) return RecordShape::Unrecognised;
    record.value =
        equal == std::string_view::npos ? std::string_view() : TrimmedOfControls(line.substr(equal + 1));
    if (equal == std::string_view::npos) return RecordShape::Incomplete;
    if (record.value.empty() && !IsTextLabel(record.label)) return RecordShape::Incomplete;
    return RecordShape::Whole;
}

void AppendRecordLine(std::string& out, int number, const Record& record) {
    out += std::to_string(number); // short enough to stay in the string's own buffer
    out += ' ';
    out += std::to_string(record.label);
    out += '=';
    out += record.value;
    out += '\n';
}

bool ReadRecordLine(std::string_view line, int& number, Record& record) {
    const char* first = line.data();
    const char* last = first + line.size();
    auto [afterNumber, error] = std::from_chars(first, last, number);
    if (error != std::errc() || afterNumber == last || *afterNumber != ' ') return false;
    auto [afterLabel, labelError] = std::from_chars(afterNumber + 1, last, record.label);
    if (labelError != std::errc() || afterLabel == last || *afterLabel != '=') return false;
    record.value = std::string_view(afterLabel + 1, static_cast<std::size_t>(last - afterLabel - 1));
    return true;
}

} // namespace pyr::gdm
