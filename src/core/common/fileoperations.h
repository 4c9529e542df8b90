// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

class Prompter;

// The file and folder operations the program relies on. None of them throws or fails its
// caller: each answers with its result, and only writeTextFile reports a failure itself.
namespace FileOperations {

// The path trimmed of spaces and ending in a separator ("\" and "/" both count; the platform's
// own is added), or empty for an empty path.
QString addTrailingSlash(const QString &path);

struct FileCheck
{
    Prompter *warnTo = nullptr; // shows "Missing File" when set and the file is missing
    QString warningSuffix;      // appended to that message
    bool create = false;        // creates a missing file empty (the answer stays false)
};

// True when the path names an existing file (not a folder).
bool fileExists(const QString &path, const FileCheck &check = {});
// True when the path existed before the call (a file counts); with create, a missing folder
// is made, one level only.
bool folderExists(const QString &path, bool create = false);
// True when the target exists afterwards.
bool copyFile(const QString &source, const QString &target, bool overwrite);
void createEmptyTextFile(const QString &path, bool overwrite);
// Replaces the file with the text and a closing CR LF. The old content stays intact until
// the new one is complete; a failure is reported under "WriteFile".
bool writeTextFile(const QString &path, const QString &text, Prompter &prompter);
void deleteFile(const QString &path);
// Every line of the file followed by CR LF, or empty when there is no such file.
QString readTextFile(const QString &path);
// Deletes the folder with everything in it. Symbolic links inside are removed as links; what
// they point to is never touched. 0 on success, -1 when the path is unusable, otherwise the
// error number of the first step that failed.
int deleteFolderTree(const QString &path);
// deleteFolderTree on an existing folder; false when it failed.
bool clearFolder(const QString &path);

inline constexpr int PathFileAccessError = 75;

} // namespace FileOperations
