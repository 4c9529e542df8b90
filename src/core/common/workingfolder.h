// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

#include <memory>

class QLockFile;
class QTemporaryDir;

// Where one run keeps its working files: the report page and pictures (the temporary folder)
// and the MoneyWorks export (jobs.inf). Two processes that shared them would read each other's
// invoice counts and print each other's graphs, so each process has its own. The desktop
// program keeps them in its program folder while it holds that folder's lock; a second copy,
// and every command-line run, gets a private folder that is removed when it ends.
class WorkingFolder
{
public:
    enum class Kind { Shared, Private };

    explicit WorkingFolder(Kind kind);
    ~WorkingFolder();
    WorkingFolder(const WorkingFolder &) = delete;
    WorkingFolder &operator=(const WorkingFolder &) = delete;

    // The folder, ending in a separator, for a program whose folder is the given one; decided
    // at the first call and kept for the run. Empty when no folder could be had.
    QString folderFor(const QString &appFolder);
    // Whether the folder is this process's alone because another one holds the program folder.
    bool isPrivate() const { return m_private != nullptr; }
    // Lets go of the folder: the lock is released and a private folder removed.
    void release();

private:
    Kind m_kind;
    QString m_folder;
    std::unique_ptr<QLockFile> m_lock;
    std::unique_ptr<QTemporaryDir> m_private;
};
