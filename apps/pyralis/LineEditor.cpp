#include "LineEditor.h"

#include "Signals.h"
#include "core/SafeFile.h"

#include <algorithm>
#include <cerrno>
#include <clocale>
#include <cstdio>
#include <cstring>
#include <cwctype>
#include <filesystem>
#include <fstream>
#include <histedit.h>
#include <langinfo.h>
#include <poll.h>
#include <sstream>
#include <unistd.h>

namespace {

using pyr::ui::LinePurpose;
using pyr::ui::TypedLine;

constexpr int kHistorySize = 500;
// How long an Escape waits for the rest of a key's sequence (an arrow sends Escape, '[', 'A'): a lone
// Escape is the key itself.
constexpr int kEscapeSequenceMs = 100;
constexpr wchar_t kEscape = 0x1b;
constexpr wchar_t kCancelKey = 0x07; // Ctrl-G, the key bound to the cancelling of the line

// UTF-8 to the editor's wide characters and back; a byte that is not UTF-8 is kept as the character of
// the same number.
std::wstring Wide(std::string_view text) {
    std::wstring wide;
    for (std::size_t i = 0; i < text.size();) {
        const unsigned char lead = static_cast<unsigned char>(text[i]);
        const int more = lead >= 0xF8 ? 0 : lead >= 0xF0 ? 3 : lead >= 0xE0 ? 2 : lead >= 0xC0 ? 1 : 0;
        unsigned long c = lead & (0x3F >> more);
        bool valid = more > 0 && i + more < text.size();
        for (int k = 1; valid && k <= more; ++k) {
            const unsigned char next = static_cast<unsigned char>(text[i + k]);
            valid = (next & 0xC0) == 0x80;
            c = (c << 6) | (next & 0x3F);
        }
        if (!valid) {
            wide += static_cast<wchar_t>(lead);
            ++i;
        } else {
            wide += static_cast<wchar_t>(c);
            i += more + 1;
        }
    }
    return wide;
}

std::string Utf8(const wchar_t* begin, const wchar_t* end) {
    std::string text;
    for (const wchar_t* p = begin; p != end; ++p) {
        const unsigned long c = static_cast<unsigned long>(*p);
        if (c < 0x80) {
            text += static_cast<char>(c);
        } else if (c < 0x800) {
            text += static_cast<char>(0xC0 | (c >> 6));
            text += static_cast<char>(0x80 | (c & 0x3F));
        } else if (c < 0x10000) {
            text += static_cast<char>(0xE0 | (c >> 12));
            text += static_cast<char>(0x80 | ((c >> 6) & 0x3F));
            text += static_cast<char>(0x80 | (c & 0x3F));
        } else {
            text += static_cast<char>(0xF0 | (c >> 18));
            text += static_cast<char>(0x80 | ((c >> 12) & 0x3F));
            text += static_cast<char>(0x80 | ((c >> 6) & 0x3F));
            text += static_cast<char>(0x80 | (c & 0x3F));
        }
    }
    return text;
}

char Lower(char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

bool StartsWithIgnoringCase(std::string_view text, std::string_view start) {
    if (text.size() < start.size()) return false;
    for (std::size_t i = 0; i < start.size(); ++i)
        if (Lower(text[i]) != Lower(start[i])) return false;
    return true;
}

LineEditor* Self(EditLine* el) {
    void* data = nullptr;
    el_wget(el, EL_CLIENTDATA, &data);
    return static_cast<LineEditor*>(data);
}

enum class ByteRead { Byte, End, Interrupted, Failed };

ByteRead ReadByte(EditLine* el, unsigned char& byte) {
    while (true) {
        pollfd waited[2] = {{STDIN_FILENO, POLLIN, 0}, {InterruptDescriptor(), POLLIN, 0}};
        const int ready = poll(waited, waited[1].fd < 0 ? 1 : 2, -1);
        if (TakeResize()) el_resize(el);
        if (ready < 0) {
            if (errno == EINTR) continue;
            return ByteRead::Failed;
        }
        if (waited[1].fd >= 0 && waited[1].revents != 0 && TakeInterrupt()) return ByteRead::Interrupted;
        if (waited[0].revents == 0) continue;
        const ssize_t n = read(STDIN_FILENO, &byte, 1);
        if (n == 1) return ByteRead::Byte;
        if (n == 0) return ByteRead::End;
        if (errno != EINTR && errno != EAGAIN) return ByteRead::Failed;
    }
}

// Whether another byte follows at once, as in a key's sequence.
bool MoreComing() {
    pollfd input = {STDIN_FILENO, POLLIN, 0};
    return poll(&input, 1, kEscapeSequenceMs) > 0;
}

// The editor's characters are those of the program's texts, UTF-8, whatever the person's locale says: a
// letter with an accent then takes one column, not an escape. Only the classes of characters change,
// never how numbers are written.
void UseUtf8Characters() {
    const char* locale = std::setlocale(LC_CTYPE, "");
    if (!locale || std::strcmp(nl_langinfo(CODESET), "UTF-8") != 0) std::setlocale(LC_CTYPE, "C.UTF-8");
}

} // namespace

LineEditor::LineEditor(std::vector<std::string> names, std::string historyFile)
    : m_names(std::move(names)), m_historyFile(std::move(historyFile)) {
    m_history = history_winit();
    HistEventW event;
    history_w(m_history, &event, H_SETSIZE, kHistorySize);
    history_w(m_history, &event, H_SETUNIQUE, 1);
    if (!m_historyFile.empty()) {
        std::ifstream file(m_historyFile, std::ios::binary);
        for (std::string line; std::getline(file, line);)
            if (!line.empty()) history_w(m_history, &event, H_ENTER, Wide(line).c_str());
    }
}

LineEditor::~LineEditor() {
    if (m_answerLine) el_end(m_answerLine);
    if (m_commandLine) el_end(m_commandLine);
    history_wend(m_history);
}

bool LineEditor::Usable() {
    return isatty(STDIN_FILENO) && isatty(STDERR_FILENO);
}

EditLine* LineEditor::Make(bool commands) {
    UseUtf8Characters();
    EditLine* el = el_init("pyralis", stdin, stderr, stderr);
    el_wset(el, EL_EDITOR, L"emacs");
    el_wset(el, EL_CLIENTDATA, static_cast<void*>(this));
    el_wset(el, EL_PROMPT, &LineEditor::PromptOf);
    el_wset(el, EL_GETCFN, &LineEditor::ReadKey);
    el_wset(el, EL_ADDFN, L"pyr-annuler", L"Annule la ligne", &LineEditor::CancelLine);
    el_wset(el, EL_BIND, L"^G", L"pyr-annuler", nullptr);
    if (commands) {
        el_wset(el, EL_HIST, history_w, m_history);
        el_wset(el, EL_BIND, L"^R", L"em-inc-search-prev", nullptr);
        el_wset(el, EL_ADDFN, L"pyr-completer", L"Complète le nom d'une commande ou d'un fichier",
                &LineEditor::CompleteCommand);
    } else {
        el_wset(el, EL_ADDFN, L"pyr-completer", L"Complète le nom d'un fichier", &LineEditor::CompleteFile);
    }
    el_wset(el, EL_BIND, L"^I", L"pyr-completer", nullptr);
    return el;
}

TypedLine LineEditor::ReadLine(std::string_view prompt, LinePurpose purpose) {
    m_prompt = Wide(prompt);
    m_cancelled = false;
    TakeInterrupt(); // a Ctrl-C typed before the question was asked does not cancel it
    // Made when first needed: a run whose command asks nothing leaves the terminal alone.
    EditLine*& el = purpose == LinePurpose::Command ? m_commandLine : m_answerLine;
    if (!el) el = Make(purpose == LinePurpose::Command);
    // The terminal leaves its line mode before the prompt is shown: a key typed as soon as the prompt
    // appears (Ctrl-D, an arrow) then reaches the editor instead of the terminal's own line editing.
    el_wset(el, EL_PREP_TERM, 1);
    int count = 0;
    const wchar_t* line = el_wgets(el, &count);
    TypedLine typed;
    if (m_cancelled || !line || count <= 0) {
        // The cursor is still after the prompt: what follows starts a line of its own.
        std::fputc('\n', stderr);
        std::fflush(stderr);
        typed.kind = m_cancelled ? TypedLine::Kind::Cancel : TypedLine::Kind::End;
        return typed;
    }
    const wchar_t* end = line + count;
    while (end != line && (end[-1] == L'\n' || end[-1] == L'\r'))
        --end;
    typed.kind = TypedLine::Kind::Line;
    typed.text = Utf8(line, end);
    return typed;
}

bool LineEditor::Remember(const std::string& line) {
    HistEventW event;
    history_w(m_history, &event, H_ENTER, Wide(line).c_str());
    if (m_historyFile.empty()) return true;
    // Oldest first, one command a line.
    std::string text;
    for (int found = history_w(m_history, &event, H_LAST); found != -1;
         found = history_w(m_history, &event, H_PREV)) {
        const wchar_t* end = event.str;
        while (*end && *end != L'\n')
            ++end;
        text += Utf8(event.str, end);
        text += '\n';
    }
    std::error_code ignored;
    std::filesystem::create_directories(std::filesystem::path(m_historyFile).parent_path(), ignored);
    const int error = pyr::ReplaceFileContents(m_historyFile, text);
    if (error == 0) return true;
    m_failure = "Historique des commandes non enregistré : " + pyr::FileWriteFailure(m_historyFile, error);
    return false;
}

std::vector<std::string> LineEditor::Completions(std::string_view word) const {
    std::vector<std::string> found;
    for (const std::string& name : m_names)
        if (StartsWithIgnoringCase(name, word) && std::find(found.begin(), found.end(), name) == found.end())
            found.push_back(name);
    return found;
}

wchar_t* LineEditor::PromptOf(EditLine* el) {
    return Self(el)->m_prompt.data();
}

unsigned char LineEditor::CancelLine(EditLine* el, int) {
    Self(el)->m_cancelled = true;
    return CC_EOF;
}

unsigned char LineEditor::CompleteFile(EditLine* el, int key) {
    return _el_fn_complete(el, key);
}

// The first word of the line is a command's name; the words after it are options and files.
unsigned char LineEditor::CompleteCommand(EditLine* el, int key) {
    const LineInfoW* line = el_wline(el);
    const wchar_t* start = line->cursor;
    while (start != line->buffer && !std::iswspace(static_cast<wint_t>(start[-1])))
        --start;
    for (const wchar_t* before = line->buffer; before != start; ++before)
        if (!std::iswspace(static_cast<wint_t>(*before))) return _el_fn_complete(el, key);

    const std::string word = Utf8(start, line->cursor);
    const std::vector<std::string> found = Self(el)->Completions(word);
    if (found.empty()) return CC_REFRESH_BEEP;
    // What every name found begins with, spelled as the first one.
    std::size_t common = found.front().size();
    for (const std::string& name : found) {
        std::size_t i = 0;
        while (i < common && i < name.size() && Lower(name[i]) == Lower(found.front()[i]))
            ++i;
        common = i;
    }
    if (found.size() == 1 || common > word.size()) {
        el_wdeletestr(el, static_cast<int>(line->cursor - start));
        std::wstring completed = Wide(found.front().substr(0, common));
        if (found.size() == 1) completed += L' ';
        el_winsertstr(el, completed.c_str());
        return CC_REFRESH;
    }
    // Nothing more to add: the names that remain possible.
    std::string list = "\n";
    std::size_t column = 0;
    for (const std::string& name : found) {
        if (column > 0 && column + name.size() > 78) {
            list += '\n';
            column = 0;
        }
        list += name + "  ";
        column += name.size() + 2;
    }
    std::fprintf(stderr, "%s\n", list.c_str());
    return CC_REDISPLAY;
}

// One key from the terminal, UTF-8 decoded. A lone Escape, and Ctrl-C at the prompt, come out as the key
// that cancels the line.
int LineEditor::ReadKey(EditLine* el, wchar_t* key) {
    unsigned char byte = 0;
    switch (ReadByte(el, byte)) {
    case ByteRead::Byte:
        break;
    case ByteRead::End:
        return 0;
    case ByteRead::Failed:
        return -1;
    case ByteRead::Interrupted:
        *key = kCancelKey;
        return 1;
    }
    if (byte == kEscape && !MoreComing()) {
        *key = kCancelKey;
        return 1;
    }
    const int more = byte >= 0xF0 ? 3 : byte >= 0xE0 ? 2 : byte >= 0xC0 ? 1 : 0;
    std::string bytes(1, static_cast<char>(byte));
    for (int k = 0; k < more; ++k) {
        if (ReadByte(el, byte) != ByteRead::Byte) break;
        bytes += static_cast<char>(byte);
    }
    const std::wstring wide = Wide(bytes);
    *key = wide.empty() ? L'?' : wide.front();
    return 1;
}
