#pragma once

#include <cstdio>
#include <string>
#include <string_view>

// Every file the program writes (GéoBases and their backups, parameter files, listings, journals, field
// book conversions, exports) is replaced whole or not at all: the new contents go to a temporary file
// beside the target, under a name that no file holds yet, are flushed to the disk, take the access rights
// (and, for root, the owner) of the file they replace, and are renamed over it; the folder is then flushed
// so that the rename itself survives a power cut. A symbolic link is followed: the file it points to is
// replaced and the link stays a link. Whatever fails (a full disk, a size limit, a folder without rights,
// the program killed), the target and every other file are left as they were and no temporary file stays.
//
// A file that exists but is read-only (no write right for its user, or no write bit at all, which even
// root respects here) is refused with EACCES: a surveyor who protected a file meant it.
namespace pyr {

// The French text of a file that could not be written, with the reason in words:
//   "Impossible d'écrire le fichier\n<chemin>\n(plus de place sur le disque).\nLe fichier est resté tel qu'il
//   était."
// (the last sentence only when the file exists: a file that did not exist was not created).
std::string FileWriteFailure(const std::string& path, int code);

// Whether the file exists and may not be written (see above). False for a file that does not exist.
bool IsReadOnlyFile(const std::string& path);

class SafeFileWriter {
public:
    enum class Start {
        Empty,     // the file's contents are replaced
        CopyOfFile // the new contents follow the file's present ones: an append that fails loses nothing
    };

    // Prepares the replacement of `path` (a file made when absent). Nothing happens to `path` before
    // Commit. Error() tells when the temporary file could not be made.
    explicit SafeFileWriter(std::string path, Start start = Start::Empty);
    // Without Commit, the temporary file is removed: the target stays as it was.
    ~SafeFileWriter();
    SafeFileWriter(const SafeFileWriter&) = delete;
    SafeFileWriter& operator=(const SafeFileWriter&) = delete;

    // The stream of the temporary file, for writers that print into a FILE*; null when it could not be
    // made. Its errors are found by Commit.
    std::FILE* File() { return m_file; }
    // Writes bytes; false (and Error() set) on failure. Later writes then do nothing.
    bool Write(std::string_view bytes);
    // The same for the large pieces of a big file: written straight to the file, past the stream's buffer
    // (flushed first), and the system is asked to start putting them on the disk at once, so that the
    // sync of Commit waits only for the last of them.
    bool WriteThrough(std::string_view bytes);
    // Flushes, syncs, gives the rights, renames over the target and syncs the folder. False on failure:
    // the target is untouched and Error() says why.
    bool Commit();
    // Gives up: the temporary file is removed now.
    void Abandon();

    // The errno of the first failure, 0 when none.
    int Error() const { return m_error; }
    // FileWriteFailure of the path as given.
    std::string FailureText() const { return FileWriteFailure(m_path, m_error); }
    // The path as given, and the file really replaced (a link's target).
    const std::string& Path() const { return m_path; }
    const std::string& Target() const { return m_target; }

private:
    bool Fail(int code);

    std::string m_path;
    std::string m_target;
    std::string m_temporary;
    std::FILE* m_file = nullptr;
    bool m_exists = false;
    unsigned m_mode = 0;
    unsigned m_uid = 0;
    unsigned m_gid = 0;
    int m_slot = -1;
    int m_error = 0;
    // For WriteThrough: the position in the file, the data before m_sent on its way to the disk.
    bool m_through = false;
    long long m_position = 0;
    long long m_sent = 0;
};

// Replaces the file's contents with `bytes`. Returns 0 or the errno of the failure.
int ReplaceFileContents(const std::string& path, std::string_view bytes);
// Adds `bytes` at the end of the file (made when absent), through a copy. Returns 0 or an errno.
int AppendToFile(const std::string& path, std::string_view bytes);
// Makes `to` a copy of `from`, replacing it whole. Returns 0 or an errno (ENOENT when `from` is absent).
int CopyFileContents(const std::string& from, const std::string& to);

// Removes the temporary files of the writers still open; only async-signal-safe calls, for a handler of
// SIGINT or SIGTERM that ends the program.
void RemovePendingTemporaryFiles();

} // namespace pyr
