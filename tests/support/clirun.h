// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QProcess>
#include <QStringList>

// One run of veltrix-cli, its per-user files (settings, data folder) kept under home.
struct CliRun
{
    int exitCode = -1;
    QString out;
    QString err;

    QStringList lines() const { return out.split(u'\n', Qt::SkipEmptyParts); }
};

inline void startCli(QProcess &process, const QStringList &arguments, const QString &home,
                     QProcessEnvironment environment = QProcessEnvironment::systemEnvironment())
{
    environment.insert(QStringLiteral("XDG_CONFIG_HOME"), home + QStringLiteral("/config"));
    environment.insert(QStringLiteral("XDG_DATA_HOME"), home + QStringLiteral("/data"));
    process.setProcessEnvironment(environment);
    process.start(QStringLiteral(VELTRIX_CLI), arguments);
}

inline CliRun finishCli(QProcess &process)
{
    CliRun run;
    if (process.state() != QProcess::NotRunning && !process.waitForFinished(300000))
        return run;
    run.exitCode = process.exitCode();
    run.out = QString::fromUtf8(process.readAllStandardOutput());
    run.err = QString::fromUtf8(process.readAllStandardError());
    return run;
}

inline CliRun runCli(const QStringList &arguments, const QString &home)
{
    QProcess process;
    startCli(process, arguments, home);
    return finishCli(process);
}
