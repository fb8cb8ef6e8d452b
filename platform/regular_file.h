// A regular file that is read, and perhaps rewritten in place; one source for each system, and
// regular_file.cpp for what is the same on all of them.
#pragma once

#include "platform/pinned_directory.h"

#include <string>

/// The last call of the system that failed.
struct FailedCall
{
    // What the library says.
    static constexpr const char* Open = "can't open file '%s'";
    static constexpr const char* List = "Cannot enumerate files in directory '%s'";
    static constexpr const char* Read = "can't read from file '%s'";
    static constexpr const char* Write = "can't write to file '%s'";

    const char* what = Open;
    unsigned long error = 0; // as the system numbers it

    /// One of the four, with the system's last error.
    static FailedCall Now(const char* what);

    /// The words in which wxLogSysError reports it, and the end of them.
    wxString Describe(const wxString& shownPath) const;
    wxString Reason() const;
};

/// Bytes. A longer file is not read into memory: a planted file of terabytes must not crash a run.
constexpr std::int64_t LongestFile = std::int64_t{64} * 1024 * 1024;

/// A file that is opened without waiting (a pipe in its place would block), in a pinned directory
/// not through a link. While it is open, it stays the same file, whatever happens to its name; on
/// Windows nobody can rename or remove it (no FILE_SHARE_DELETE). No call reports an error by
/// itself; after one that failed, GetFailure says why.
class RegularFile
{
  public:
    enum class Status
    {
        NotThere, // no such file, not a regular file, or a refused link
        Refused,  // it exists, but access is denied or another program blocks it
        Open
    };

    RegularFile() = default;
    ~RegularFile();
    RegularFile(const RegularFile&) = delete;
    RegularFile& operator=(const RegularFile&) = delete;

    /// Follows links.
    Status OpenForReading(const wxString& path);
    Status OpenForReading(const PinnedDirectory& directory, const wxString& name);
    /// Opens for reading and writing. The content stays as it is.
    Status OpenForUpdate(const PinnedDirectory& directory, const wxString& name);
    /// Also opens the same file for update (ReOpenFile; elsewhere the name has to lead to the same
    /// device and inode). If the result is not Open, the file stays open for reading.
    Status ReopenForUpdate();
    /// Creates an empty file and opens it for update; fails and changes nothing if anything of that
    /// name exists (CREATE_NEW, O_EXCL).
    Status CreateNew(const PinnedDirectory& directory, const wxString& name);
    /// Opens for update and empties it, or creates it. Returns false if that fails.
    bool OpenEmpty(const PinnedDirectory& directory, const wxString& name);
    /// Puts a new, empty file in place of one that cannot be written.
    Status Replace(const PinnedDirectory& directory, const wxString& name);
    static const bool CanReplace; // whether the system allows that to whoever may create files
    void Close();

    /// In bytes; -1 if it cannot be determined.
    std::int64_t Length() const;
    /// Reads the whole current content; returns false if it is longer than `most`, or cannot be
    /// read to its end.
    bool Read(std::string& bytes, std::int64_t most = LongestFile) const;

    /// Replaces the whole content, which has to be `before`. First reserves space for a longer one,
    /// if the system can, so that a full disk leaves the file as it was. Writes once, a shorter
    /// content with line feeds up to the old length, and then cuts the file. If any of that fails,
    /// restores the old bytes and returns false. Finally waits for the disk, whatever comes of it.
    /// If the process is ended meanwhile, the file has the old content, the new one, or the new one
    /// followed by line feeds, provided that the system does not interrupt a write.
    bool Rewrite(const std::string& before, const std::string& after);

    /// Copies the content of the other file in pieces, after reserving space for it.
    bool TakeContent(const RegularFile& source);

    /// Copies what wxCopyFile copies in addition to the content, except read-only, which would keep
    /// the next copy away. Windows: the attributes and the time of the last change; elsewhere: the
    /// mode.
    void TakeAttributes(const RegularFile& source);
    /// Whether hidden, system and read-only, or the mode, are as TakeAttributes leaves them.
    bool HasAttributesOf(const RegularFile& source) const;

    const FailedCall& GetFailure() const;

    /// Cuts the file, or extends it with zeros.
    bool SetLength(std::int64_t length);

    /// Appends all the bytes or, if that fails, none. Does not wait for the disk.
    bool Append(const std::string& bytes);

  private:
    // In no directory, links are followed.
    Status Open(const PinnedDirectory* directory, const wxString& path, bool forUpdate);
    bool Reserve(std::int64_t from, std::int64_t length);
    void WaitForDisk();
    // Until the count is reached or the file ends; less if a call fails.
    size_t ReadAt(std::int64_t offset, char* bytes, size_t count) const;
    bool Write(std::int64_t offset, const char* bytes, size_t count);
    // At least one byte; 0 if there are none or the call fails.
    size_t ReadSome(std::int64_t offset, char* bytes, size_t count) const;
    size_t WriteSome(std::int64_t offset, const char* bytes, size_t count);
    wxString m_path;
    mutable FailedCall m_failure;
#ifdef _WIN32
    void* m_handle = nullptr;
#else
    int m_descriptor = -1;
    bool m_followsLinks = false;
#endif
};
