#include "fieldbook/TableCodeFile.h"

#include "core/Lines.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "fieldbook/TableCodeMessages.h"
#include "fieldbook/TableCodeWords.h"

#include <algorithm>

namespace pyr {

namespace {

constexpr std::string_view kSeparatorLabel = "Séparateur";
constexpr std::string_view kColumnGap = "  ";
// What a table written from nothing starts with, for the person who opens it.
constexpr std::string_view kNewTableHeader[] = {
    "; Table de codes PYRALIS",
    "; code   commande   complément (symbole, calque, texte)   ; description",
};

bool IsCommentOrBlank(std::string_view line) {
    const std::string_view text = Trimmed(line);
    return text.empty() || text.front() == ';' || text.front() == '#';
}

// The setting of a separator line ("Séparateur = A...Z", the '=' optional, the value in double quotes
// when it holds blanks at its ends); false when the line is no separator line.
bool ReadSeparatorLine(std::string_view line, std::string_view& setting) {
    std::string_view rest = Trimmed(line);
    std::size_t end = 0;
    while (end < rest.size() && rest[end] != '=' && rest[end] != ' ' && rest[end] != '\t')
        ++end;
    if (CommandKey(rest.substr(0, end)) != CommandKey(kSeparatorLabel)) return false;
    rest = Trimmed(rest.substr(end));
    if (!rest.empty() && rest.front() == '=') rest = Trimmed(rest.substr(1));
    if (rest.size() >= 2 && rest.front() == '"' && rest.back() == '"') rest = rest.substr(1, rest.size() - 2);
    setting = rest;
    return true;
}

std::string SeparatorLineText(std::string_view setting) {
    const bool quoted = setting.empty() || setting.front() == ' ' || setting.front() == '\t' ||
                        setting.back() == ' ' || setting.back() == '\t' ||
                        (setting.size() >= 2 && setting.front() == '"' && setting.back() == '"');
    std::string text(kSeparatorLabel);
    text += " = ";
    if (quoted) text += '"';
    text += setting;
    if (quoted) text += '"';
    return text;
}

bool EndsWithCrLf(std::string_view text) {
    const std::size_t end = text.find_first_of("\r\n");
    return end != std::string_view::npos && text[end] == '\r' && end + 1 < text.size() &&
           text[end + 1] == '\n';
}

// The columns of a code line, quoted where they must be.
struct CodeColumns {
    std::string code;
    std::string complement;
};

// Whether a code, written bare at the head of its line, would make the line read as something else: a
// comment ("#12"), or the separator line ("Séparateur", whatever its case and accents, alone or before
// '='). Such a code was written in double quotes and is written back so.
bool CodeNeedsQuotes(std::string_view code) {
    if (code.starts_with('#')) return true;
    return CommandKey(code.substr(0, code.find('='))) == CommandKey(kSeparatorLabel);
}

CodeColumns ColumnsOf(const CodeTableLine& line) {
    CodeColumns columns;
    AppendWord(columns.code, line.code);
    if (CodeNeedsQuotes(line.code) && !columns.code.starts_with('"')) columns.code = '"' + columns.code + '"';
    for (const std::string& word : line.complement)
        AppendWord(columns.complement, word);
    return columns;
}

void AppendPadded(std::string& out, std::string_view text, std::size_t width) {
    out += PadRight(text, static_cast<int>(width));
}

} // namespace

CodeTableContent ParseCodeTable(std::string_view text, const CodeTableReport& report) {
    CodeTableContent table;
    table.crlf = EndsWithCrLf(text);
    int separatorLine = 0;
    std::vector<std::string> words;
    ForEachLine(text, [&](std::string_view line, int number) {
        CodeTableLine& kept = table.lines.emplace_back();
        kept.text = line;
        std::string_view setting;
        if (IsCommentOrBlank(line)) return;
        if (ReadSeparatorLine(line, setting)) {
            if (separatorLine != 0) {
                report(number, Sprintf(msg::kSeparatorDefinedTwice, separatorLine));
            } else if (setting.empty()) {
                report(number, msg::kSeparatorMissing);
            } else {
                separatorLine = number;
                table.separator = setting;
                kept.kind = CodeTableLine::Kind::Separator;
            }
            return;
        }
        const std::size_t comment = CommentStart(line);
        const std::size_t count = SplitWords(line.substr(0, comment), words);
        if (count < 2) {
            report(number, Sprintf(msg::kCodeWithoutCommand, count == 1 ? words[0].c_str() : ""));
            return;
        }
        const std::string_view command = InterpretedCommandWord(words[1]);
        if (command.empty()) {
            report(number, Sprintf(msg::kUnknownCommand, words[1].c_str(), words[0].c_str()));
            return;
        }
        const auto [first, added] = table.codes.emplace(CodeKey(words[0]), table.lines.size() - 1);
        if (!added) {
            report(number,
                   Sprintf(msg::kCodeDefinedTwice, words[0].c_str(), static_cast<int>(first->second) + 1));
            return;
        }
        kept.kind = CodeTableLine::Kind::Code;
        kept.text.clear();
        kept.code = words[0];
        kept.command = command;
        kept.complement.assign(words.begin() + 2, words.end());
        if (comment != std::string_view::npos) kept.description = Trimmed(line.substr(comment + 1));
    });
    return table;
}

std::string FormatCodeTable(const CodeTableContent& table) {
    const std::string_view end = table.crlf ? "\r\n" : "\n";
    std::vector<CodeColumns> columns(table.lines.size());
    std::size_t codeWidth = 0;
    std::size_t commandWidth = 0;
    std::size_t complementWidth = 0;
    bool hasSeparatorLine = false;
    for (std::size_t i = 0; i < table.lines.size(); ++i) {
        const CodeTableLine& line = table.lines[i];
        hasSeparatorLine = hasSeparatorLine || line.kind == CodeTableLine::Kind::Separator;
        if (line.kind != CodeTableLine::Kind::Code) continue;
        columns[i] = ColumnsOf(line);
        codeWidth = std::max(codeWidth, Utf8Length(columns[i].code));
        commandWidth = std::max(commandWidth, Utf8Length(line.command));
        complementWidth = std::max(complementWidth, Utf8Length(columns[i].complement));
    }

    std::string out;
    auto writeLine = [&](std::string line) {
        while (!line.empty() && (line.back() == ' ' || line.back() == '\t'))
            line.pop_back();
        out += line;
        out += end;
    };
    if (table.lines.empty())
        for (std::string_view header : kNewTableHeader)
            writeLine(std::string(header));
    // Without a separator line of its own, the table gets one after its opening comments.
    std::size_t separatorAt = table.lines.size() + 1;
    if (!hasSeparatorLine) {
        separatorAt = 0;
        while (separatorAt < table.lines.size() &&
               table.lines[separatorAt].kind == CodeTableLine::Kind::Text &&
               IsCommentOrBlank(table.lines[separatorAt].text))
            ++separatorAt;
    }
    for (std::size_t i = 0; i <= table.lines.size(); ++i) {
        if (i == separatorAt) writeLine(SeparatorLineText(table.separator));
        if (i == table.lines.size()) break;
        const CodeTableLine& line = table.lines[i];
        switch (line.kind) {
        case CodeTableLine::Kind::Text:
            writeLine(line.text);
            break;
        case CodeTableLine::Kind::Separator:
            writeLine(SeparatorLineText(table.separator));
            break;
        case CodeTableLine::Kind::Code: {
            std::string text;
            AppendPadded(text, columns[i].code, codeWidth);
            text += kColumnGap;
            AppendPadded(text, line.command, commandWidth);
            text += kColumnGap;
            AppendPadded(text, columns[i].complement, complementWidth);
            if (!line.description.empty()) {
                text += kColumnGap;
                text += "; ";
                text += line.description;
            }
            writeLine(std::move(text));
            break;
        }
        }
    }
    return out;
}

} // namespace pyr
