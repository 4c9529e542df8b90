// Veltrix — KPI dashboard for small businesses.
#include "common/fileoperations.h"
#include "common/recordingprompter.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <QTest>

#ifdef Q_OS_UNIX
#include <sys/stat.h>
#endif

using namespace Qt::StringLiterals;
using namespace FileOperations;

namespace {

void writeFile(const QString &path, const QByteArray &content = "x")
{
    QFile file(path);
    QVERIFY2(file.open(QIODevice::WriteOnly), qPrintable(path));
    file.write(content);
}

QByteArray contentOf(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

} // namespace

class TestFileOperations : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void addTrailingSlash_data();
    void addTrailingSlash();
    void fileExistsAndEmptyFiles();
    void folderExistsAnswers();
    void copyFileRespectsOverwrite();
    void writeAndReadText_data();
    void writeAndReadText();
    void writeTextFile();
    void deleteFolderTreeRemovesEverything();
    void deleteFolderTreeRefuses_data();
    void deleteFolderTreeRefuses();

private:
    QString path(const QString &name) const { return m_dir->filePath(name); }

    std::unique_ptr<QTemporaryDir> m_dir;
    RecordingPrompter m_prompter;
};

void TestFileOperations::init()
{
    m_dir = std::make_unique<QTemporaryDir>();
    m_prompter.clearMessages();
}

void TestFileOperations::addTrailingSlash_data()
{
    QTest::addColumn<QString>("path");
    QTest::addColumn<QString>("expected");
    const QString sep = QDir::separator();
    QTest::newRow("empty") << QString() << QString();
    QTest::newRow("only spaces") << u"   "_s << sep;
    QTest::newRow("ends in slash") << u"/srv/data/"_s << u"/srv/data/"_s;
    QTest::newRow("ends in backslash") << u"C:\\x\\"_s << u"C:\\x\\"_s;
    QTest::newRow("spaces around") << u"  C:\\x  "_s << u"C:\\x"_s + sep;
    QTest::newRow("plain folder") << u"/srv/data"_s << u"/srv/data"_s + sep;
    QTest::newRow("tab is not trimmed") << u"/srv\t"_s << u"/srv\t"_s + sep;
}

void TestFileOperations::addTrailingSlash()
{
    QFETCH(QString, path);
    QFETCH(QString, expected);
    QCOMPARE(FileOperations::addTrailingSlash(path), expected);
}

void TestFileOperations::fileExistsAndEmptyFiles()
{
    writeFile(path(u".hidden"_s));
    writeFile(path(u"readonly"_s));
    QFile::setPermissions(path(u"readonly"_s), QFileDevice::ReadOwner);
    QVERIFY(!fileExists(QString()));
    QVERIFY(fileExists(path(u".hidden"_s)));
    QVERIFY(fileExists(path(u"readonly"_s)));
    QVERIFY(!fileExists(path(u"missing"_s)));
    QVERIFY(!fileExists(m_dir->path())); // a folder is not a file
    QVERIFY(!fileExists(path(u"*"_s)));  // no wildcards
    QVERIFY(m_prompter.messages().isEmpty());

    const QString missing = path(u"report.html"_s);
    QVERIFY(!fileExists(missing, {&m_prompter, u" Print again."_s, false}));
    QCOMPARE(m_prompter.messages().size(), 1);
    QCOMPARE(m_prompter.messages().first().text,
             u"The file '"_s + missing + u"' does not exist! Print again."_s);
    QCOMPARE(m_prompter.messages().first().title, u"Missing File"_s);
    QCOMPARE(m_prompter.messages().first().icon, Prompter::Icon::Exclamation);

    QVERIFY(!fileExists(missing, {nullptr, {}, true}));
    QVERIFY(QFileInfo(missing).isFile());
    QCOMPARE(QFileInfo(missing).size(), 0);
    QVERIFY(fileExists(missing, {&m_prompter, {}, true}));
    QCOMPARE(m_prompter.messages().size(), 1);

    // An empty text file is made where there is none, and over one only when told to.
    const QString jobs = path(u"jobs.inf"_s);
    createEmptyTextFile(jobs, false);
    QVERIFY(QFileInfo(jobs).isFile());
    writeFile(jobs, "kept");
    createEmptyTextFile(jobs, false);
    QCOMPARE(contentOf(jobs), QByteArray("kept"));
    createEmptyTextFile(jobs, true);
    QCOMPARE(QFileInfo(jobs).size(), 0);
}

void TestFileOperations::folderExistsAnswers()
{
    const QString folder = path(u"temp"_s);
    QVERIFY(!folderExists(QString()));
    QVERIFY(!folderExists(folder));
    QVERIFY(!QFileInfo::exists(folder));
    QVERIFY(!folderExists(folder, true)); // created, but it did not exist before
    QVERIFY(QFileInfo(folder).isDir());
    QVERIFY(folderExists(folder));
    QVERIFY(folderExists(folder + u'/'));

    // Only one level is made.
    QVERIFY(!folderExists(path(u"a/b/c"_s), true));
    QVERIFY(!QFileInfo::exists(path(u"a"_s)));

    // A file answers to the listing too.
    writeFile(path(u"main.db"_s));
    QVERIFY(folderExists(path(u"main.db"_s)));
}

void TestFileOperations::copyFileRespectsOverwrite()
{
    writeFile(path(u"new.db"_s), "template");
    const QString target = path(u"main.db"_s);
    QVERIFY(!copyFile(path(u"missing.db"_s), target, true));
    QVERIFY(copyFile(path(u"new.db"_s), target, false));
    QCOMPARE(contentOf(target), QByteArray("template"));

    writeFile(target, "live data");
    QVERIFY(!copyFile(path(u"new.db"_s), target, false));
    QCOMPARE(contentOf(target), QByteArray("live data"));
    QVERIFY(copyFile(path(u"new.db"_s), target, true));
    QCOMPARE(contentOf(target), QByteArray("template"));

    // A target in a folder that does not exist cannot be made.
    QVERIFY(!copyFile(path(u"new.db"_s), path(u"nowhere/main.db"_s), true));

#ifdef Q_OS_UNIX
    // The copy takes the user's umask, not the template's mode: an installed template is
    // world-readable (or read-only), the shop's database with its passwords must not be.
    QFile::setPermissions(path(u"new.db"_s),
                          QFileDevice::ReadOwner | QFileDevice::ReadGroup | QFileDevice::ReadOther);
    const mode_t saved = ::umask(077);
    const bool copied = copyFile(path(u"new.db"_s), target, true);
    ::umask(saved);
    QVERIFY(copied);
    QCOMPARE(QFile::permissions(target) & 0x0FFF, QFileDevice::ReadUser | QFileDevice::WriteUser);
#endif
}

void TestFileOperations::writeAndReadText_data()
{
    QTest::addColumn<QByteArray>("onDisk");
    QTest::addColumn<QString>("read");
    QTest::newRow("CR LF lines") << QByteArray("a\r\nb\r\n") << u"a\r\nb\r\n"_s;
    QTest::newRow("LF lines") << QByteArray("a\nb\n") << u"a\r\nb\r\n"_s;
    QTest::newRow("CR lines") << QByteArray("a\rb\r") << u"a\r\nb\r\n"_s;
    QTest::newRow("no final line end") << QByteArray("a\r\nb") << u"a\r\nb\r\n"_s;
    QTest::newRow("blank line kept") << QByteArray("a\r\n\r\nb\r\n") << u"a\r\n\r\nb\r\n"_s;
    QTest::newRow("empty file") << QByteArray() << QString();
    QTest::newRow("UTF-8") << QByteArray("Caf\xc3\xa9\n") << u"Caf\u00e9\r\n"_s;
}

void TestFileOperations::writeAndReadText()
{
    QFETCH(QByteArray, onDisk);
    QFETCH(QString, read);
    writeFile(path(u"file.txt"_s), onDisk);
    QCOMPARE(readTextFile(path(u"file.txt"_s)), read);
    QCOMPARE(readTextFile(path(u"missing.txt"_s)), QString());
}

void TestFileOperations::writeTextFile()
{
    QVERIFY(FileOperations::writeTextFile(path(u"out.txt"_s), u"first\r\nsecond"_s, m_prompter));
    QCOMPARE(contentOf(path(u"out.txt"_s)), QByteArray("first\r\nsecond\r\n"));
    QVERIFY(m_prompter.messages().isEmpty());
    const QString file = path(u"no-folder/out.txt"_s);
    QVERIFY(!FileOperations::writeTextFile(file, u"text"_s, m_prompter));
    QCOMPARE(m_prompter.messages().size(), 1);
    const RecordingPrompter::Message &shown = m_prompter.messages().first();
    QCOMPARE(shown.title, u"WriteFile Error 75"_s);
    QVERIFY(shown.text.startsWith(u"Error 75\r\n\r\n"_s));
    QCOMPARE(shown.icon, Prompter::Icon::Exclamation);
}

void TestFileOperations::deleteFolderTreeRemovesEverything()
{
    // Hidden, read-only and oddly named entries all go; what links point at stays.
    const QString outside = path(u"precious"_s);
    QVERIFY(QDir().mkpath(outside + u"/inner"_s));
    writeFile(outside + u"/ledger.db"_s, "keep me");
    writeFile(outside + u"/inner/notes.txt"_s, "keep me too");
    const QString root = path(u"temp"_s);
    QVERIFY(QDir().mkpath(root + u"/deep/deeper"_s));
    QVERIFY(QDir().mkpath(root + u"/.hidden-folder"_s));
    QVERIFY(QDir().mkpath(root + u"/ leading space"_s));
    writeFile(root + u"/tmp.html"_s);
    writeFile(root + u"/.hidden"_s);
    writeFile(root + u"/ leading space/x.gif"_s);
    writeFile(root + u"/deep/deeper/tmp.bmp"_s);
    writeFile(root + u"/deep/readonly.txt"_s);
    QVERIFY(QFile::link(outside, root + u"/link-to-folder"_s));
    QVERIFY(QFile::link(outside + u"/ledger.db"_s, root + u"/deep/link-to-file"_s));
    QVERIFY(QFile::link(path(u"gone"_s), root + u"/broken-link"_s));
    QFile::setPermissions(root + u"/deep/readonly.txt"_s, QFileDevice::ReadOwner);
    QFile::setPermissions(root + u"/.hidden-folder"_s,
                          QFileDevice::ReadOwner | QFileDevice::ExeOwner);

    QCOMPARE(deleteFolderTree(u"  "_s + root + u"/  "_s), 0);
    QVERIFY(!QFileInfo::exists(root));
    QVERIFY(QFileInfo(m_dir->path()).isDir());
    QVERIFY(clearFolder(root)); // nothing left to clear
    // Deleted through a link, only the link goes.
    QVERIFY(QFile::link(outside, root));
    QVERIFY(clearFolder(root));
    QVERIFY(!QFileInfo(root).isSymLink());
    QCOMPARE(contentOf(outside + u"/ledger.db"_s), QByteArray("keep me"));
    QCOMPARE(contentOf(outside + u"/inner/notes.txt"_s), QByteArray("keep me too"));
}

void TestFileOperations::deleteFolderTreeRefuses_data()
{
    QTest::addColumn<QString>("target");
    QTest::newRow("empty") << QString();
    QTest::newRow("spaces") << u"   "_s;
    QTest::newRow("bare name without separator") << u"temp"_s;
    QTest::newRow("missing folder") << u"<dir>/missing"_s;
    QTest::newRow("a file") << u"<dir>/file.txt"_s;
    QTest::newRow("the file system root") << u"/"_s;
}

void TestFileOperations::deleteFolderTreeRefuses()
{
    QFETCH(QString, target);
    writeFile(path(u"file.txt"_s));
    target.replace(u"<dir>"_s, m_dir->path());
    QCOMPARE(deleteFolderTree(target), -1);
    QVERIFY(QFileInfo::exists(path(u"file.txt"_s)));
}

QTEST_GUILESS_MAIN(TestFileOperations)
#include "tst_fileoperations.moc"
