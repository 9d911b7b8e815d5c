#include "fieldbook/TableCode.h"

#include "core/Files.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "fieldbook/TableCodeFile.h"
#include "fieldbook/TableCodeMessages.h"
#include "fieldbook/TableCodeWords.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"
#include "settings/IniFileStore.h"
#include "ui/PyrTxtWnd.h"

#include <cerrno>
#include <cmath>

namespace pyr {

struct CTableCode::Impl {
    std::string fileName;
    CodeTableContent table;

    const CodeTableLine* FindCode(std::string_view code) const {
        if (table.codes.empty()) return nullptr;
        const auto found = table.codes.find(CodeKey(code));
        return found == table.codes.end() ? nullptr : &table.lines[found->second];
    }

    // The code without the separator that may head it ("+EXR" with "±", "/ARB" with the literal "/"):
    // the table's codes are written without it.
    std::string_view WithoutSeparator(std::string_view code) const {
        const std::string_view separator = table.separator;
        if (separator == kSeparatorSign) {
            if (!code.empty() && (code.front() == '+' || code.front() == '-')) code.remove_prefix(1);
        } else if (separator != kSeparatorUpper && separator != kSeparatorLower && !separator.empty() &&
                   code.substr(0, separator.size()) == separator) {
            code.remove_prefix(separator.size());
        }
        return code;
    }
};

CTableCode::CTableCode() : m_impl(std::make_unique<Impl>()) {}

CTableCode::~CTableCode() = default;

bool CTableCode::Init(const std::string& path, CPyrTxtWnd* txt) {
    m_impl->table = {};
    m_impl->fileName.clear();
    std::string bytes;
    if (path.empty()) return false;
    if (!ReadWholeFile(path, bytes)) {
        if (txt) txt->Print(msg::kCodeTableCannotRead, path.c_str(), SystemErrorText(errno).c_str());
        return false;
    }
    bool headed = false;
    m_impl->table = ParseCodeTable(FileBytesToUtf8(bytes), [&](int line, const std::string& reason) {
        if (!txt) return;
        // The field book's own line errors may follow: say once which file these lines belong to.
        if (!headed) txt->Print(msg::kCodeTableHeading, path.c_str());
        headed = true;
        txt->Print(msg::kCodeTableLineError, line, reason.c_str());
    });
    m_impl->fileName = path;
    return true;
}

bool CTableCode::Save(const std::string& path) const {
    return !path.empty() && ReplaceFileContents(path, FormatCodeTable(m_impl->table)) == 0;
}

const std::string& CTableCode::FileName() const {
    return m_impl->fileName;
}

const std::string& CTableCode::Separator() const {
    return m_impl->table.separator;
}

void CTableCode::SetSeparator(std::string separator) {
    m_impl->table.separator = std::move(separator);
}

int CTableCode::Make_str_cmd(std::string_view text, std::vector<std::string>& words) const {
    return static_cast<int>(SplitWords(text, words));
}

std::unique_ptr<CElement> CTableCode::InterpreteTexte(const std::vector<std::string>& words,
                                                      int& kind) const {
    kind = kKindCommand;
    if (words.empty()) return nullptr;
    // A code of the table first, then a command word written as it stands in the field book.
    const CodeTableLine* entry = nullptr;
    std::string_view command;
    const std::string_view written = words[0];
    const std::string_view bare = m_impl->WithoutSeparator(written);
    for (const std::string_view code : {written, bare}) {
        entry = m_impl->FindCode(code);
        command = entry ? entry->command : InterpretedCommandWord(code);
        if (!command.empty() || bare.size() == written.size()) break;
    }
    if (command.empty()) return nullptr;

    // What the table adds (a symbol, a layer) comes before what the surveyor typed after the code.
    std::string parameters;
    if (entry)
        for (const std::string& word : entry->complement)
            AppendWord(parameters, word);
    for (std::size_t i = 1; i < words.size(); ++i)
        AppendWord(parameters, words[i]);

    const int commandKind = CommandKind(command);
    if (commandKind == kKindExcentrement) {
        // The offset in metres comes first; an eccentricity without a readable one would be taken as 0.
        const std::string* first = entry && !entry->complement.empty() ? &entry->complement.front()
                                   : words.size() > 1                  ? &words[1]
                                                                       : nullptr;
        double offset = 0.0;
        if (!first || !ParseDouble(*first, offset) || !std::isfinite(offset)) return nullptr;
    }
    kind = commandKind;
    return std::make_unique<CCommande>(std::string(command), std::move(parameters));
}

std::size_t CodePosition(std::string_view nameAndCode, std::string_view separator) {
    const std::size_t none = nameAndCode.size();
    const bool upper = separator == kSeparatorUpper;
    if (upper || separator == kSeparatorLower) {
        std::size_t length = 1;
        for (std::size_t i = 0; i < nameAndCode.size(); i += length) {
            const bool letter = upper ? IsUpperCaseLetterAt(nameAndCode, i, length)
                                      : IsLowerCaseLetterAt(nameAndCode, i, length);
            if (letter) return i;
        }
        return none;
    }
    if (separator.empty()) return none;
    const std::size_t at =
        separator == kSeparatorSign ? nameAndCode.find_first_of("+-") : nameAndCode.find(separator);
    return at == std::string_view::npos ? none : at;
}

} // namespace pyr
