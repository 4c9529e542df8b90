// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QProcess>
#include <QRegularExpression>
#include <QStringList>
#include <QUrl>

// veltrix-mw-sim running for a test, on a free loopback port.
class SimulatorProcess
{
public:
    ~SimulatorProcess()
    {
        m_process.kill();
        m_process.waitForFinished();
    }

    // Starts the simulator with the given options (--ledger, --document, ...); false when it
    // did not come up, with the reason in problem().
    bool start(const QStringList &options)
    {
        m_process.start(QStringLiteral(VELTRIX_MW_SIM),
                        options + QStringList{QStringLiteral("--port"), QStringLiteral("0")});
        if (!m_process.waitForReadyRead(20000)) {
            m_problem = QString::fromUtf8(m_process.readAllStandardError());
            return false;
        }
        const QString line = QString::fromUtf8(m_process.readLine());
        const QRegularExpressionMatch match =
            QRegularExpression(QStringLiteral(":(\\d+)\\s*$")).match(line);
        m_port = match.hasMatch() ? match.captured(1).toInt() : 0;
        if (m_port == 0)
            m_problem = line;
        return m_port != 0;
    }

    int port() const { return m_port; }
    QString problem() const { return m_problem; }
    QString address(const QString &document) const
    {
        return QStringLiteral("http://127.0.0.1:%1/").arg(m_port) +
               QString::fromLatin1(QUrl::toPercentEncoding(document));
    }

private:
    QProcess m_process;
    int m_port = 0;
    QString m_problem;
};
