// Veltrix — KPI dashboard for small businesses.
#include "fileoperations.h"

#include "errorreporter.h"
#include "prompter.h"
#include "texttrim.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSaveFile>
#include <QStringConverter>
#include <QTextStream>

using namespace Qt::StringLiterals;

namespace FileOperations {

namespace {

const auto LineEnd = u"\r\n"_s;

bool isSeparator(QChar c)
{
    return c == u'\\' || c == u'/';
}

bool isLink(const QFileInfo &info)
{
    return info.isSymbolicLink() || info.isJunction();
}

// Removes a link itself, whether it points at a file, at a folder or nowhere.
bool removeLink(const QFileInfo &link)
{
    const QString path = link.absoluteFilePath();
    if (QFile::remove(path))
        return true;
    return QDir().rmdir(path);
}

} // namespace

QString addTrailingSlash(const QString &path)
{
    if (path.isEmpty())
        return {};
    QString result = trimmedOfSpaces(path);
    if (result.isEmpty() || !isSeparator(result.back()))
        result += QDir::separator();
    return result;
}

bool fileExists(const QString &path, const FileCheck &check)
{
    if (path.isEmpty())
        return false;
    if (QFileInfo(path).isFile())
        return true;
    if (check.create) {
        QFile file(path);
        if (file.open(QIODevice::WriteOnly | QIODevice::NewOnly))
            file.close();
    }
    if (check.warnTo) {
        check.warnTo->message(u"The file '"_s + path + u"' does not exist!"_s + check.warningSuffix,
                              u"Missing File"_s, Prompter::Icon::Exclamation);
    }
    return false;
}

bool folderExists(const QString &path, bool create)
{
    if (path.isEmpty())
        return false;
    const QFileInfo info(path);
    if (info.exists())
        return true;
    if (create)
        QDir().mkdir(path);
    return false;
}

bool copyFile(const QString &source, const QString &target, bool overwrite)
{
    if (!QFileInfo(source).isFile())
        return false;
    if (QFileInfo::exists(target)) {
        if (!overwrite)
            return false;
        QFile::remove(target);
    }
    // Written as a new file rather than copied with its source's mode: a database made from a
    // read-only or world-readable template takes the user's own default permissions (umask).
    QFile in(source);
    QFile out(target);
    if (!in.open(QIODevice::ReadOnly) || !out.open(QIODevice::WriteOnly | QIODevice::NewOnly))
        return false;
    while (!in.atEnd()) {
        const QByteArray chunk = in.read(1 << 16);
        if (chunk.isEmpty() || out.write(chunk) != chunk.size()) {
            out.remove();
            return false;
        }
    }
    return out.flush();
}

void createEmptyTextFile(const QString &path, bool overwrite)
{
    if (QFileInfo::exists(path)) {
        if (!overwrite)
            return;
        QFile::remove(path);
    }
    QFile file(path);
    if (file.open(QIODevice::WriteOnly))
        file.close();
}

bool writeTextFile(const QString &path, const QString &text, Prompter &prompter)
{
    QSaveFile file(path);
    if (file.open(QIODevice::WriteOnly)) {
        const QByteArray bytes = (text + LineEnd).toUtf8();
        if (file.write(bytes) == bytes.size() && file.commit())
            return true;
    }
    const QString reason =
        file.errorString().isEmpty() ? u"Path/File access error"_s : file.errorString();
    ErrorReporter(prompter).reportError(PathFileAccessError, reason, u"WriteFile"_s);
    return false;
}

void deleteFile(const QString &path)
{
    const QFileInfo info(path);
    if (info.isFile() || info.isSymbolicLink())
        QFile::remove(path);
}

QString readTextFile(const QString &path)
{
    QFile file(path);
    if (!QFileInfo(path).isFile() || !file.open(QIODevice::ReadOnly))
        return {};
    QTextStream in(&file);
    in.setEncoding(QStringConverter::Utf8);
    QString result;
    QString line;
    while (in.readLineInto(&line)) {
        // readLineInto splits on LF and CR LF; a lone CR still ends a line.
        const QStringList parts = line.split(u'\r');
        for (const QString &part : parts)
            result += part + LineEnd;
    }
    return result;
}

namespace {

int deleteFolderContentsAndFolder(const QString &folder)
{
    // Without write and search permission on the folder its entries cannot be removed.
    QFile::setPermissions(folder, QFile::permissions(folder) | QFileDevice::ReadOwner |
                                      QFileDevice::WriteOwner | QFileDevice::ExeOwner);

    const QDir dir(folder);
    const QFileInfoList entries = dir.entryInfoList(
        QDir::AllEntries | QDir::Hidden | QDir::System | QDir::NoDotAndDotDot, QDir::NoSort);
    QStringList subfolders;
    for (const QFileInfo &entry : entries) {
        if (isLink(entry)) {
            if (!removeLink(entry))
                return PathFileAccessError;
        } else if (entry.isDir()) {
            subfolders << entry.absoluteFilePath();
        } else {
            const QString file = entry.absoluteFilePath();
            if (!entry.isWritable())
                QFile::setPermissions(file, QFile::permissions(file) | QFileDevice::WriteOwner);
            if (!QFile::remove(file))
                return PathFileAccessError;
        }
    }
    for (const QString &subfolder : std::as_const(subfolders)) {
        if (const int result = deleteFolderContentsAndFolder(subfolder); result != 0)
            return result;
    }
    return QDir().rmdir(folder) ? 0 : PathFileAccessError;
}

} // namespace

int deleteFolderTree(const QString &path)
{
    QString folder = trimmedOfSpaces(path);
    if (folder.size() > 1 && isSeparator(folder.back()))
        folder.chop(1);
    const bool hasSeparator = folder.contains(u'\\') || folder.contains(u'/');
    const QFileInfo info(folder);
    // A whole drive or the file system root is never a folder this program may clear.
    if (folder.isEmpty() || !hasSeparator || !info.isDir() || QDir(folder).isRoot())
        return -1;
    // A link to a folder is not the folder: remove the link and leave its target alone.
    if (isLink(info))
        return removeLink(info) ? 0 : PathFileAccessError;
    return deleteFolderContentsAndFolder(info.absoluteFilePath());
}

bool clearFolder(const QString &path)
{
    if (!QFileInfo(path).isDir())
        return true;
    return deleteFolderTree(path) == 0;
}

} // namespace FileOperations
