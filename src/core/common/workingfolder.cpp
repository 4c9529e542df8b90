// Veltrix — KPI dashboard for small businesses.
#include "workingfolder.h"

#include "fileoperations.h"

#include <QLockFile>
#include <QTemporaryDir>

using namespace Qt::StringLiterals;

WorkingFolder::WorkingFolder(Kind kind)
    : m_kind(kind)
{}

WorkingFolder::~WorkingFolder() = default;

QString WorkingFolder::folderFor(const QString &appFolder)
{
    if (!m_folder.isEmpty())
        return m_folder;
    if (m_kind == Kind::Shared) {
        // A lock left by a copy that crashed is taken over; one held by a running copy is not.
        auto lock = std::make_unique<QLockFile>(appFolder + u"working.lock"_s);
        lock->setStaleLockTime(0);
        if (lock->tryLock()) {
            m_lock = std::move(lock);
            m_folder = FileOperations::addTrailingSlash(appFolder);
            return m_folder;
        }
    }
    auto own = std::make_unique<QTemporaryDir>();
    if (!own->isValid())
        return {};
    m_private = std::move(own);
    m_folder = FileOperations::addTrailingSlash(m_private->path());
    return m_folder;
}

void WorkingFolder::release()
{
    m_lock.reset();
    m_private.reset();
    m_folder.clear();
}
