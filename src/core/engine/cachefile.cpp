// Veltrix — KPI dashboard for small businesses.
#include "cachefile.h"

#include <QFile>
#include <QSaveFile>

using namespace Qt::StringLiterals;

namespace CacheFile {

std::optional<ReadProblem> read(const QString &path, PeriodDataSet::Slot &slot)
{
    QFile file(path);
    if (!file.exists())
        return std::nullopt;
    if (!file.open(QIODevice::ReadOnly))
        return ReadProblem{
            u"The cache file '%1' cannot be read: %2"_s.arg(path, file.errorString())};

    const QString text = QString::fromUtf8(file.readAll());
    const QStringList lines = QString(text).replace(u"\r\n"_s, u"\n"_s).split(u'\n');
    int lineNumber = 0;
    for (const QString &line : lines) {
        ++lineNumber;
        if (line.trimmed().isEmpty())
            continue;
        const QStringList fields = line.split(u'\t');
        if (fields.size() < 4) {
            return ReadProblem{
                u"Line %1 of the cache file '%2' has fewer than four fields."_s.arg(lineNumber)
                    .arg(path),
                true};
        }
        slot.fieldIds << fields[0];
        slot.fieldValues << fields[1];
        slot.fieldAbs << fields[2];
        slot.fieldTypes << fields[3];
    }
    return std::nullopt;
}

std::optional<QString> setAside(const QString &path, const QDateTime &moment)
{
    const QString stem = path + u".damaged-"_s + moment.toString(u"yyyyMMdd-HHmmss"_s);
    QString target = stem;
    for (int n = 2; QFile::exists(target); ++n)
        target = stem + u'-' + QString::number(n);
    if (!QFile::rename(path, target))
        return std::nullopt;
    return target;
}

bool write(const QString &path, const PeriodDataSet::Slot &slot)
{
    QByteArray content;
    for (int i = 0; i < slot.size(); ++i) {
        content += (slot.fieldIds.value(i) + u'\t' + slot.fieldValues.value(i) + u'\t' +
                    slot.fieldAbs.value(i) + u'\t' + slot.fieldTypes.value(i) + u"\r\n"_s)
                       .toUtf8();
    }
    QSaveFile file(path);
    if (!file.open(QIODevice::WriteOnly))
        return false;
    if (file.write(content) != content.size()) {
        file.cancelWriting();
        return false;
    }
    return file.commit();
}

} // namespace CacheFile
