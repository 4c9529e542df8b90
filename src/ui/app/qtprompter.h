// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "common/prompter.h"

#include <QPointer>
#include <QWidget>

// Message boxes, the wait cursor and the file dialogs of the desktop.
class QtPrompter final : public Prompter
{
public:
    QtPrompter() = default;
    ~QtPrompter() override;

    // Dialogs open over this window when it is set.
    void setParentWindow(QWidget *window) { m_parent = window; }

    void setBusyPointer() override;
    void setNormalPointer() override;
    QString chooseFile(const QString &title, const QString &startPath,
                       const QString &filter) override;
    QString chooseFolder(const QString &title, const QString &startPath) override;

protected:
    Answer showMessage(const QString &text, const QString &title, Icon icon,
                       Buttons buttons) override;

private:
    QPointer<QWidget> m_parent;
    int m_busyDepth = 0;
};
