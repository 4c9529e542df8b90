// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "app/appcontext.h"
#include "app/demoworkspace.h"
#include "app/mainconnector.h"
#include "app/producecommand.h"
#include "app/settingsloader.h"
#include "common/recordingprompter.h"
#include "common/settingsstore.h"

#include <QTemporaryDir>
#include <QTextStream>

#include <memory>

// The demo shop written to a temporary folder, started up, logged in as sysop and produced
// for its last whole financial year: what the benchmarks measure from.
class DemoSession
{
public:
    // False (with the reason on standard error) when the demo cannot be made or started.
    bool open()
    {
        if (DemoWorkspace::create(m_root.filePath(QStringLiteral("demo")),
                                  QStringLiteral(VELTRIX_NEW_DB))) {
            QTextStream(stderr) << "cannot write the demo workspace" << Qt::endl;
            return false;
        }
        m_context = std::make_unique<AppContext>(
            std::make_unique<SettingsStore>(m_root.filePath(QStringLiteral("demo/settings.ini"))),
            m_prompter, AppLocations::inFolder(m_root.filePath(QStringLiteral("app"))));
        if (!loadSettings(*m_context).isEmpty() || !connectMainDatabase(*m_context).isEmpty()) {
            QTextStream(stderr) << "start-up failed" << Qt::endl;
            return false;
        }
        m_context->loginState() = LoginState{true, QStringLiteral("sysop"), 1, QString()};
        return ProduceCommand(*m_context).produce({7, 2025, 6, 2026}) ==
               ProduceCommand::Outcome::Produced;
    }

    AppContext &context() { return *m_context; }

private:
    QTemporaryDir m_root;
    RecordingPrompter m_prompter;
    std::unique_ptr<AppContext> m_context;
};
