// A regular file that is read, and perhaps rewritten in place; one source for each system, and
// regular_file.cpp for what is the same on all.
#pragma once

#include "platform/pinned_directory.h"

#include <wx/string.h>

#include <cstdint>
#include <string>

/// Bytes. What is longer is not read into memory: a planted file of terabytes must not end a run.
constexpr std::int64_t LongestFile = std::int64_t{256} * 1024 * 1024;

/// A file opened without waiting for another program (at a pipe in its place) and, where links are
/// refused, not through one. No call reports an error by itself.
///
/// As long as the object lives it is the same file, whatever happens to its name; on Windows no
/// program can rename or remove it meanwhile (it is opened without FILE_SHARE_DELETE).
class RegularFile
{
  public:
    enum class Status
    {
        NotOpen,
        NotThere, // nothing of that name that counts: no regular file, or a refused link
        Refused,  // it is there, but may not be opened that way, or another program keeps it
        Gone,     // the name does not lead to the same file any more
        Open
    };

    enum class Wait
    {
        ForDisk,
        ForNothing
    };

    RegularFile() = default;
    ~RegularFile();
    RegularFile(const RegularFile&) = delete;
    RegularFile& operator=(const RegularFile&) = delete;

    Status OpenForReading(const wxString& path, Links links);
    /// For reading and writing. The content stays as it is.
    Status OpenForUpdate(const wxString& path, Links links);
    /// Opens the same file for update as well (ReOpenFile; elsewhere the name has to lead to the
    /// same device and inode). Unless the result is Open, the file stays open for reading.
    Status ReopenForUpdate();
    /// Makes a new, empty file and opens it for update; fails, with nothing changed, when anything
    /// of that name is there (CREATE_NEW, O_EXCL).
    Status CreateNew(const wxString& path);
    /// Puts a new, empty file in the place of one that may not be written. Not on Windows, where a
    /// file's own permissions protect it from that.
    Status Replace(const wxString& path);
    static bool MayReplace(const wxString& path);
    /// False when the system reports an error, which does not matter: all bytes were handed over
    /// before.
    bool Close();

    /// In bytes; -1 when it cannot be found out.
    std::int64_t Length() const;
    /// The whole content as it is now; false when it has more bytes than that, or could not be read
    /// to its end.
    bool Read(std::string& bytes, std::int64_t most = LongestFile) const;

    /// Makes the second text the whole content, in place of the first, which is what the file
    /// holds.
    ///
    /// Room for a longer content is made before a byte changes, where the system can (a full disk
    /// leaves the file as it was). One write; a shorter content is written with line feeds up to
    /// the old length, and then cut. When any of that fails, the old bytes are put back and the
    /// result is false. At last, unless that is not wanted, waits for the disk; when that fails,
    /// the new content stays. A process that is ended meanwhile leaves the old content, the new
    /// one, or the new one followed by line feeds, as far as the system carries out a write as one.
    bool Rewrite(const std::string& before, const std::string& after, Wait wait = Wait::ForDisk);

    /// Takes over what wxCopyFile takes over with the content. Windows: the attributes and the time
    /// of the last change. Elsewhere: the mode.
    void TakeAttributes(const RegularFile& source);
    /// Whether that would leave read-only, hidden, system or the mode as they are.
    bool HasAttributesOf(const RegularFile& source) const;

    /// Has the library report that the file could not be written, under that path and with the
    /// error of the call that failed.
    void ReportNotWritten(const wxString& shownPath) const;

    /// Cuts the file, or fills it up with zeros.
    bool SetLength(std::int64_t length);

    /// Adds the bytes at the end; false, and nothing added, when that fails. Does not wait for the
    /// disk.
    bool Append(const std::string& bytes);

  private:
    bool Reserve(std::int64_t from, std::int64_t length);
    bool Write(std::int64_t offset, const std::string& bytes);
    void WaitForDisk();
    Status Open(const wxString& path, Links links, bool forUpdate);

    Status m_status = Status::NotOpen;
    wxString m_path;
    unsigned long m_error = 0; // of the last failed write, as the system numbers it
#ifdef _WIN32
    void* m_handle = nullptr;
#else
    int m_descriptor = -1;
    Links m_links = Links::Refuse;
#endif
};

/// Has the library report that the file could not be opened or read, with the system's last error:
/// on Windows in a message box after the run.
void ReportNotOpened(const wxString& path);
void ReportNotRead(const wxString& path);
