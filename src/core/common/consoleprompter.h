// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "prompter.h"

// The prompter of the headless tool: messages go to standard error, questions take their
// first button, and nothing is ever chosen from a file dialog.
class ConsolePrompter final : public Prompter
{
public:
    void setBusyPointer() override {}
    void setNormalPointer() override {}
    QString chooseFile(const QString &, const QString &, const QString &) override { return {}; }
    QString chooseFolder(const QString &, const QString &) override { return {}; }

    // Messages that warned of a problem (an error report, data out of range): a run that saw
    // one has no complete figures to give.
    int problemCount() const { return m_problems; }

protected:
    Answer showMessage(const QString &text, const QString &title, Icon icon,
                       Buttons buttons) override;

private:
    int m_problems = 0;
};
