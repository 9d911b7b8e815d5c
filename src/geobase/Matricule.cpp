#include "geobase/Matricule.h"

#include "core/TextEncoding.h"

#include <initializer_list>
#include <utility>

namespace pyr {

namespace {

// Field books pad names with blanks, tabulations, line ends or NUL bytes; a name pasted from a French
// text may carry a no-break space (U+00A0) or a narrow no-break space (U+202F).
std::size_t BlankAtFront(std::string_view text) {
    if (text.empty()) return 0;
    const auto c = static_cast<unsigned char>(text[0]);
    if (c == ' ' || c == '\t' || c == '\n' || c == '\r' || c == '\v' || c == '\f' || c == '\0') return 1;
    if (text.starts_with("\xC2\xA0")) return 2;
    if (text.starts_with("\xE2\x80\xAF")) return 3;
    return 0;
}

std::size_t BlankAtBack(std::string_view text) {
    if (text.empty()) return 0;
    const auto c = static_cast<unsigned char>(text.back());
    if (c == ' ' || c == '\t' || c == '\n' || c == '\r' || c == '\v' || c == '\f' || c == '\0') return 1;
    if (text.ends_with("\xC2\xA0")) return 2;
    if (text.ends_with("\xE2\x80\xAF")) return 3;
    return 0;
}

bool IsAsciiDigit(char c) {
    return c >= '0' && c <= '9';
}

bool IsAsciiLetterOrDigit(char c) {
    return IsAsciiDigit(c) || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z');
}

// The printf format with its %s replaced by the arguments in order; "%%" gives '%'.
std::string Substitute(std::string_view format, std::initializer_list<std::string_view> args) {
    std::string out;
    auto arg = args.begin();
    for (std::size_t i = 0; i < format.size(); ++i) {
        if (format[i] == '%' && i + 1 < format.size()) {
            if (format[i + 1] == 's' && arg != args.end()) {
                out += *arg++;
                ++i;
                continue;
            }
            if (format[i + 1] == '%') {
                out += '%';
                ++i;
                continue;
            }
        }
        out += format[i];
    }
    return out;
}

void SetWhy(std::string* why, std::string text) {
    if (why) *why = std::move(text);
}

} // namespace

std::string_view FormMatView(std::string_view id) {
    while (std::size_t n = BlankAtFront(id))
        id.remove_prefix(n);
    while (std::size_t n = BlankAtBack(id))
        id.remove_suffix(n);

    std::size_t zeros = 0;
    while (zeros < id.size() && id[zeros] == '0')
        ++zeros;
    if (zeros == 0) return id;
    if (zeros == id.size()) return id.substr(zeros - 1);
    // Zeros in front of a letter or a digit are padding; in front of another sign ("0.5", "0-1") one
    // of them is part of the name. Bytes of accented letters are >= 0x80.
    const char next = id[zeros];
    if (IsAsciiLetterOrDigit(next) || static_cast<unsigned char>(next) >= 0x80) return id.substr(zeros);
    return id.substr(zeros - 1);
}

MatParts SplitMat(std::string_view normalisedId) {
    std::size_t start = normalisedId.size();
    while (start > 0 && IsAsciiDigit(normalisedId[start - 1]))
        --start;
    MatParts parts{normalisedId.substr(0, start), normalisedId.substr(start), -1};
    std::string_view significant = parts.digits;
    while (significant.size() > 1 && significant.front() == '0')
        significant.remove_prefix(1);
    if (significant.empty() || significant.size() > 18) return parts;
    long long number = 0;
    for (char c : significant)
        number = number * 10 + (c - '0');
    parts.number = number;
    return parts;
}

void FormMat(std::string& id) {
    const std::string_view normal = FormMatView(id);
    const auto start = static_cast<std::size_t>(normal.data() - id.data());
    id.resize(start + normal.size());
    id.erase(0, start);
}

std::string FormMat(std::string_view prefix, long long number, int minDigits) {
    std::string id(prefix);
    if (number >= 0) {
        const std::string digits = std::to_string(number);
        if (minDigits > 0 && static_cast<std::size_t>(minDigits) > digits.size())
            id.append(static_cast<std::size_t>(minDigits) - digits.size(), '0');
        id += digits;
    }
    FormMat(id);
    return id;
}

bool ExtrMat(std::string_view id, std::string& prefix, long long& number) {
    const std::string_view normal = FormMatView(id);
    const MatParts parts = SplitMat(normal);
    if (parts.number < 0) {
        prefix.assign(normal);
        number = -1;
        return false;
    }
    prefix.assign(parts.prefix);
    number = parts.number;
    return true;
}

std::string NextMat(std::string_view id, const std::function<bool(std::string_view)>& isUsed,
                    long long maxTries) {
    const std::string_view normal = FormMatView(id);
    const MatParts parts = SplitMat(normal);
    std::string_view prefix = parts.prefix;
    long long number = parts.number;
    int width = static_cast<int>(parts.digits.size());
    if (parts.digits.empty()) {
        // A name without a number starts its numbering at 1: "B" -> "B1".
        prefix = normal;
        number = 0;
        width = 0;
    } else if (number < 0) {
        return {};
    }
    for (long long tries = 0; tries < maxTries; ++tries) {
        if (number >= kMaxMatNumber) return {};
        ++number;
        std::string candidate = FormMat(prefix, number, width);
        if (!isUsed || !isUsed(candidate)) return candidate;
    }
    return {};
}

bool IsValidMat(std::string_view id, std::string* why) {
    const std::string_view mat = FormMatView(id);
    if (mat.empty()) {
        SetWhy(why, msg::kMatWhyEmpty);
        return false;
    }
    if (!IsValidUtf8(mat)) {
        SetWhy(why, msg::kMatWhyNotText);
        return false;
    }
    for (std::size_t i = 0; i < mat.size(); ++i) {
        const auto c = static_cast<unsigned char>(mat[i]);
        const std::string_view rest = mat.substr(i);
        if (c == ' ' || c == '\t' || rest.starts_with("\xC2\xA0") || rest.starts_with("\xE2\x80\xAF")) {
            SetWhy(why, msg::kMatWhyBlank);
            return false;
        }
        // C0 controls, DEL, and the C1 controls U+0080 to U+009F (0xC2 0x80 to 0xC2 0x9F).
        if (c < 0x20 || c == 0x7F ||
            (c == 0xC2 && i + 1 < mat.size() && static_cast<unsigned char>(mat[i + 1]) <= 0x9F)) {
            SetWhy(why, msg::kMatWhyControl);
            return false;
        }
        if (c == ',' || c == ';') {
            SetWhy(why, Substitute(msg::kMatWhySeparator, {mat.substr(i, 1)}));
            return false;
        }
    }
    if (mat.front() == '-') {
        SetWhy(why, msg::kMatWhyLeadingDash);
        return false;
    }
    if (mat.back() == '-') {
        SetWhy(why, msg::kMatWhyTrailingDash);
        return false;
    }
    return true;
}

bool DDV_Mat(ui::FrontEnd* parent, std::string_view id) {
    ui::FrontEnd& frontEnd = parent ? *parent : ui::ApplicationFrontEnd();
    const std::string_view mat = FormMatView(id);
    if (mat.empty()) {
        frontEnd.MessageBox(msg::kMatMissing, ui::kCaption, ui::kIconWarning);
        return false;
    }
    std::string why;
    if (!IsValidMat(mat, &why)) {
        frontEnd.MessageBox(Substitute(msg::kMatIncorrect, {mat, why}), ui::kCaption, ui::kIconWarning);
        return false;
    }
    return true;
}

bool DDX_Mat(ui::FrontEnd* parent, bool saveAndValidate, std::string& fieldText, std::string& value) {
    if (!saveAndValidate) {
        fieldText = value;
        return true;
    }
    std::string mat = fieldText;
    FormMat(mat);
    if (!DDV_Mat(parent, mat)) return false;
    fieldText = mat;
    value = std::move(mat);
    return true;
}

} // namespace pyr
