#include "fieldbook/QuendalPivot.h"

#include "core/SafeFile.h"
#include "fieldbook/ConfigQdl.h"
#include "fieldbook/FieldBookFormats.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/ParamDriver.h"
#include "fieldbook/QuendalReader.h"
#include "geobase/Carnet.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <string_view>
#include <unistd.h>

namespace pyr {

namespace {

// The pivot file, written for the Quendal reader and deleted once read: a new file of its own (never one
// of the surveyor's, which TemporaryBesideCarnet avoids and the creation refuses), without the forced
// write to the disk that a file to keep gets, and removed whatever happens.
class PivotFile {
public:
    explicit PivotFile(std::string path) : m_path(std::move(path)) {
        m_fd = open(m_path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0600);
        if (m_fd < 0) m_error = errno;
        m_created = m_fd >= 0;
    }
    ~PivotFile() {
        Close();
        if (m_created) std::remove(m_path.c_str());
    }
    PivotFile(const PivotFile&) = delete;
    PivotFile& operator=(const PivotFile&) = delete;

    void Write(std::string_view bytes) {
        while (m_error == 0 && !bytes.empty()) {
            const ssize_t n = write(m_fd, bytes.data(), bytes.size());
            if (n < 0 && errno == EINTR) continue;
            if (n < 0)
                m_error = errno;
            else
                bytes.remove_prefix(static_cast<std::size_t>(n));
        }
    }
    // 0 while every byte was written, or the system error that stopped the writing.
    int Error() const { return m_error; }
    // 0 once the whole file is written, or the system error that stopped it.
    int Close() {
        if (m_fd >= 0 && close(m_fd) != 0 && m_error == 0) m_error = errno;
        m_fd = -1;
        return m_error;
    }

private:
    std::string m_path;
    int m_fd = -1;
    int m_error = 0;
    bool m_created = false;
};

} // namespace

bool CQuendalPivot::Read(const std::string& path, CCarnet& result) {
    Print(fb::kCreating);
    if (!m_importer || !Driver()) return false;
    // The records go to the Quendal-Pc file by batches as the book is read: neither the book nor its
    // records are ever held whole beside the GéoBase made of them.
    const std::string temporary = TemporaryBesideCarnet(path);
    PivotFile pivot(temporary);
    const auto cannotWrite = [&](int error) {
        (Parent() ? *Parent() : ui::ApplicationFrontEnd()).ReportFailure(FileWriteFailure(temporary, error));
        return false;
    };
    // A file that cannot be made is said before the book is read for nothing.
    pivot.Write(CDlgConfigQdl::Text(CCarnet(), {}, true));
    if (pivot.Error() != 0) return cannotWrite(pivot.Error());
    const auto drain = [&](CCarnet& records) {
        pivot.Write(CDlgConfigQdl::Text(records, {}, false));
        records.RemoveAll();
    };
    CCarnet records;
    if (!m_importer(*Driver(), path, records, TextWindow(), Parent(), drain)) return false;
    drain(records);
    if (const int error = pivot.Close(); error != 0) return cannotWrite(error);

    CQuendalReader quendal;
    quendal.SetChoices(Choices());
    quendal.SetCodeTable(CodeTable());
    quendal.SetTextWindow(TextWindow());
    quendal.SetParent(Parent());
    quendal.SetAnnounced(false);
    CCarnet geoBase;
    if (!quendal.Read(temporary, geoBase)) return false;
    result.Append(std::move(geoBase));
    if (TextWindow()) TextWindow()->Print(fb::kFinished, result.GetSize());
    return true;
}

} // namespace pyr
