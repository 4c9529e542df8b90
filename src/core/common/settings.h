// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

// The settings of the run: the program's own paths and the accounting connection, read once
// at start-up and then only read.
struct Settings
{
    // The accounting file's password is stored enciphered with this key.
    static inline const QString PasswordKey = QStringLiteral("Rv5HnW2j");

    QString appFolder;
    QString tempFolder;
    QString newDatabaseFile;
    QString cacheFile;
    QString tempHtmlFile;
    QString tempGifFile;
    QString tempBmpFile;
    QString jobsFile; // the MoneyWorks export
    QString mainDatabaseFile;

    QString accPackage; // "MYOB" or "MoneyWorks"
    QString accFilePath;
    QString accFileDriver;
    QString accFileUser;
    QString accFilePass; // deciphered

    // How long a MoneyWorks server may take to answer one request.
    int moneyWorksTimeoutSeconds = 15;

    qint16 scrollBarHeight = 16;
    qint32 currentYear = 0;
};
