// Reading and writing GéoBase files. A GéoBase is never half written (see core/SafeFile.h), never written
// over a file that is not a GéoBase or that its owner protected, and the loader never drops a line.
#include "core/FileLines.h"
#include "core/Files.h"
#include "core/Lines.h"
#include "core/SafeFile.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "geobase/Carnet.h"
#include "geobase/ElementPool.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/GeoFile.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <algorithm>
#include <atomic>
#include <cerrno>
#include <condition_variable>
#include <cstdio>
#include <cstring>
#include <fcntl.h>
#include <functional>
#include <mutex>
#include <optional>
#include <system_error>
#include <thread>
#include <unistd.h>

namespace pyr {

namespace {

void Tell(ui::FrontEnd* parent, const std::string& text, int icon) {
    (parent ? *parent : ui::ApplicationFrontEnd()).MessageBox(text, ui::kCaption, icon);
}

// A failure of what the person asked for: the running command ends on a failure status.
void ReportFailure(ui::FrontEnd* parent, const std::string& text) {
    (parent ? *parent : ui::ApplicationFrontEnd()).ReportFailure(text);
}

// Whether a GéoBase header opens the file: the first few kilobytes tell it without reading a big file.
bool OpensWithHeader(const std::string& path) {
    const int fd = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (fd < 0) return false;
    char buffer[4096];
    const ssize_t n = read(fd, buffer, sizeof buffer);
    close(fd);
    std::string_view head(buffer, n > 0 ? static_cast<size_t>(n) : 0);
    if (head.substr(0, 3) == "\xEF\xBB\xBF") head.remove_prefix(3);
    return GeoHeaderVersion(head.substr(0, head.find_first_of("\r\n"))) != 0;
}

// A store is written a run of elements at a time: about 400 KB of text for a run, small enough that
// formatting the next runs overlaps writing this one, large enough that a write costs little.
constexpr size_t kRunElements = 8192;
// Stores from this many runs are formatted by two threads.
constexpr size_t kRunsForTwoThreads = 4;

using ElementArray = std::vector<std::unique_ptr<CElement>>;

// The text of a run of elements, lines ended, kept from run to run.
class RunText {
public:
    std::string_view View() const { return {m_bytes.data(), m_size}; }

    void Format(const ElementArray& elements, const std::vector<int>& kinds, size_t first, size_t last,
                bool header) {
        m_size = 0;
        if (header) {
            const std::string line = GeoHeaderLine();
            Reserve(line.size() + 1);
            std::memcpy(m_bytes.data(), line.data(), line.size());
            m_size = line.size();
            m_bytes[m_size++] = '\n';
        }
        for (size_t i = first; i < last; ++i) {
            const CElement& element = *elements[i];
            Reserve(ElementLineBound(element, kinds[i]));
            char* end = WriteElementLine(m_bytes.data() + m_size, element, kinds[i]);
            *end++ = '\n';
            m_size = static_cast<size_t>(end - m_bytes.data());
        }
    }

private:
    // Room for `bytes` more.
    void Reserve(size_t bytes) {
        if (m_bytes.size() - m_size >= bytes) return;
        // About 48 bytes a line: a run seldom grows past its first size.
        m_bytes.resize(std::max({m_bytes.size() * 2, m_size + bytes, kRunElements * 64}));
    }

    std::string m_bytes;
    size_t m_size = 0;
};

// Writes the runs of a store in order: two threads format runs, and whichever finishes the run next in
// line writes it and those ready after it, while the other goes on formatting. A thread takes a buffer
// before it takes a run, so that the run next in line always has one: no wait can close on itself.
class TwoThreadWriter {
public:
    TwoThreadWriter(const ElementArray& elements, const std::vector<int>& kinds, bool header,
                    const std::function<bool(std::string_view)>& write)
        : m_elements(elements), m_kinds(kinds), m_header(header), m_write(write),
          m_runs((elements.size() + kRunElements - 1) / kRunElements), m_ready(m_runs, nullptr) {
        for (auto& buffer : m_buffers)
            m_free.push_back(&buffer);
    }

    bool Run() {
        std::thread helper;
        try {
            helper = std::thread([this] { Work(); });
        } catch (const std::system_error&) {
            // No second thread: this one does it all.
        }
        Work();
        if (helper.joinable()) helper.join();
        return !m_failed && m_written == m_runs;
    }
    // The errno of a failure that was not the writing's own (memory), 0 when none.
    int Failure() const { return m_failure; }

private:
    void Work() {
        try {
            while (true) {
                RunText* text = TakeBuffer();
                if (!text) return;
                const size_t run = m_next.fetch_add(1);
                if (run >= m_runs) {
                    GiveBack(text);
                    return;
                }
                const size_t first = run * kRunElements;
                text->Format(m_elements, m_kinds, first, std::min(first + kRunElements, m_elements.size()),
                             m_header && run == 0);
                Ready(run, text);
            }
        } catch (const std::bad_alloc&) {
            std::lock_guard lock(m_mutex);
            m_failed = true;
            m_failure = ENOMEM;
            m_changed.notify_all();
        }
    }

    RunText* TakeBuffer() {
        std::unique_lock lock(m_mutex);
        m_changed.wait(lock, [this] { return m_failed || !m_free.empty(); });
        if (m_failed) return nullptr;
        RunText* text = m_free.back();
        m_free.pop_back();
        return text;
    }

    void GiveBack(RunText* text) {
        std::lock_guard lock(m_mutex);
        m_free.push_back(text);
        m_changed.notify_all();
    }

    // The run is formatted: written now if it is next in line and no thread is writing, else left to the
    // thread that writes.
    void Ready(size_t run, RunText* text) {
        std::unique_lock lock(m_mutex);
        m_ready[run] = text;
        if (m_writing) return;
        m_writing = true;
        while (!m_failed && m_written < m_runs && m_ready[m_written]) {
            RunText* next = m_ready[m_written];
            lock.unlock();
            const bool written = m_write(next->View());
            lock.lock();
            if (!written) m_failed = true;
            m_ready[m_written] = nullptr;
            ++m_written;
            m_free.push_back(next);
            m_changed.notify_all();
        }
        m_writing = false;
    }

    const ElementArray& m_elements;
    const std::vector<int>& m_kinds;
    const bool m_header;
    const std::function<bool(std::string_view)>& m_write;
    const size_t m_runs;

    std::atomic<size_t> m_next{0};
    std::mutex m_mutex;
    std::condition_variable m_changed;
    RunText m_buffers[4];
    std::vector<RunText*> m_free;
    std::vector<RunText*> m_ready;
    size_t m_written = 0;
    bool m_writing = false;
    bool m_failed = false;
    int m_failure = 0;
};

// Writes the text of a store through `write`, by two threads for a big store.
bool WriteStore(const ElementArray& elements, const std::vector<int>& kinds, bool header,
                const std::function<bool(std::string_view)>& write, int& failure) {
    failure = 0;
    const size_t runs = (elements.size() + kRunElements - 1) / kRunElements;
    if (runs >= kRunsForTwoThreads && std::thread::hardware_concurrency() >= 2) {
        TwoThreadWriter writer(elements, kinds, header, write);
        const bool written = writer.Run();
        failure = writer.Failure();
        return written;
    }
    RunText text;
    for (size_t first = 0; first < elements.size() || (first == 0 && header); first += kRunElements) {
        text.Format(elements, kinds, first, std::min(first + kRunElements, elements.size()),
                    header && first == 0);
        if (!write(text.View())) return false;
    }
    return true;
}

} // namespace

namespace {

// After this many lines of a file, the count of its elements is guessed.
constexpr int kLinesBeforeEstimate = 4096;

// After `elements` were read from the first `bytesRead` bytes of a file of `fileBytes`, makes the memory of
// the elements still to come ready in `preparation`, by another thread while the rest is read. The
// elements of a big job take nearly a hundred bytes each; nine tenths of the guess is asked, so that what
// is made ready is used.
void PrepareForTheRest(std::optional<ElementPool::Preparation>& preparation, int elements,
                       std::uint64_t bytesRead, std::uint64_t fileBytes) {
    constexpr std::uint64_t kElementBytes = 96;
    if (bytesRead == 0 || fileBytes <= bytesRead || elements <= 0) return;
    const std::uint64_t rest = static_cast<std::uint64_t>(elements) * (fileBytes - bytesRead) / bytesRead;
    if (rest > 0) preparation.emplace(static_cast<std::size_t>(rest * kElementBytes * 9 / 10));
}

} // namespace

int CCarnet::Load(CPyrTxtWnd* txt, const std::string& path, const std::string& configuration, int report,
                  ui::FrontEnd* parent) {
    RemoveAll();
    m_path = path;
    m_configuration = configuration;

    m_knownPath.clear();
    m_knownForeign = false;

    // The file is read by chunks, never whole, and its lines become elements as they come.
    FileLines file;
    std::optional<ElementPool::Preparation> preparation;
    bool lenient = false;
    std::string error;
    GeoFileCensus census;
    const auto readLine = [&](const FileLines::Line& read) {
        const std::string_view line = read.text;
        const int number = read.number;
        if (number == kLinesBeforeEstimate) {
            PrepareForTheRest(preparation, GetSize(), read.end, file.Size());
            const auto more =
                static_cast<std::size_t>(GetSize()) * file.Size() / std::max<std::uint64_t>(read.end, 1);
            m_elements.reserve(more);
            m_kinds.reserve(more);
        }
        if (int version = GeoHeaderVersion(line)) {
            if (number == 1 && version > kGeoFormatVersion) {
                lenient = true;
                if (txt) txt->Print(msg::kNewerVersion, path.c_str(), version, kGeoFormatVersion);
            }
            census.header = true;
            return; // a header line carries no element, wherever it stands
        }
        if (number == 1 && txt) txt->Print(msg::kNoHeader, path.c_str());
        if (IsBlankGeoLine(line)) return;
        int kind = 0;
        auto element = ParseElementLine(line, kind, error, lenient);
        census.Line(element != nullptr);
        if (element) {
            AddChecked(std::move(element), kind);
            return;
        }
        // Kept word for word, so that the next save writes it back.
        AddChecked(std::make_unique<CComment>(std::string(line)), kKindComment);
        if (txt) txt->Print(msg::kLineKept, number, error.c_str());
    };
    if (!file.Open(path) || !file.ForEach(readLine, [&] {
            if (txt) txt->Print(msg::kReadAsWindows1252, path.c_str());
        })) {
        const std::string why = SystemErrorText(errno);
        RemoveAll();
        Tell(parent, Sprintf(msg::kCannotOpen, path.c_str(), why.c_str()), ui::kIconWarning);
        return 0;
    }
    m_knownPath = path;
    m_knownForeign = census.IsForeign();
    if (txt && m_knownForeign) txt->Print(msg::kOpenedForeign, path.c_str(), census.unreadable, census.lines);
    if (txt && IsReadOnlyFile(path)) txt->Print(msg::kOpenedReadOnly, path.c_str());
    if (report && txt) txt->Print(msg::kLoaded, path.c_str(), GetSize());
    return 1;
}

bool CCarnet::Write(std::FILE* file, bool withHeader) const {
    if (!file) return false;
    int failure = 0;
    const bool written = WriteStore(
        m_elements, m_kinds, withHeader,
        [file](std::string_view bytes) {
            return std::fwrite(bytes.data(), 1, bytes.size(), file) == bytes.size();
        },
        failure);
    if (failure != 0) errno = failure;
    return written && std::ferror(file) == 0;
}

bool CCarnet::IsForeignFile(const std::string& path) const {
    if (!FileExists(path)) return false; // nothing there to lose
    if (path == m_knownPath) return m_knownForeign;
    if (OpensWithHeader(path)) return false;
    // Rare: a save under another name, over a file without a header at its top.
    std::string bytes;
    return ReadWholeFile(path, bytes) && TakeGeoFileCensus(bytes).IsForeign();
}

std::string CCarnet::SaveRefusal(const std::string& path) const {
    if (IsReadOnlyFile(path)) return msg::kRefusedReadOnly;
    if (IsForeignFile(path)) return msg::kRefusedForeign;
    return {};
}

int CCarnet::Save(const std::string& path, ui::FrontEnd* parent, bool report) {
    std::string failure = SaveRefusal(path);
    if (failure.empty()) {
        SafeFileWriter writer(path);
        int code = 0;
        if (!writer.File()) {
            code = writer.Error();
        } else {
            int failure = 0;
            const bool written = WriteStore(
                m_elements, m_kinds, true,
                [&writer](std::string_view bytes) { return writer.WriteThrough(bytes); }, failure);
            if (!written) {
                code = writer.Error() != 0 ? writer.Error() : failure != 0 ? failure : EIO;
                writer.Abandon();
            } else if (!writer.Commit()) {
                code = writer.Error();
            }
        }
        if (code != 0)
            failure = Sprintf(msg::kSaveFailedReason, SystemErrorText(code).c_str()) +
                      (FileExists(path) ? msg::kLeftAsItWas : "");
    }
    if (!failure.empty()) {
        ReportFailure(parent, Sprintf(msg::kSaveFailed, path.c_str()) + failure);
        return 0;
    }
    m_path = path;
    m_knownPath = path; // a GéoBase now, written here
    m_knownForeign = false;
    if (report) Tell(parent, Sprintf(msg::kSaved, path.c_str()), ui::kIconInformation);
    return 1;
}

int CCarnet::BackUp(ui::FrontEnd* parent) {
    if (m_path.empty() || !FileExists(m_path)) return 1;
    if (const std::string refusal = SaveRefusal(m_path); !refusal.empty()) {
        ReportFailure(parent, Sprintf(msg::kSaveFailed, m_path.c_str()) + refusal);
        return 0;
    }
    const std::string backup = ReplaceExtension(m_path, "bak");
    if (const int code = CopyFileContents(m_path, backup)) {
        ReportFailure(parent, Sprintf(msg::kBackUpFailed, m_path.c_str(), backup.c_str(),
                                      SystemErrorText(code).c_str()));
        return 0;
    }
    return 1;
}

} // namespace pyr
