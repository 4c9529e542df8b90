// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "prompter.h"

#include <QList>
#include <QQueue>

// A prompter without a display: it records every message and pointer change and answers from
// a script. With no scripted answer left it takes the first button (OK or Yes), as pressing
// Enter would.
class RecordingPrompter final : public Prompter
{
public:
    struct Message
    {
        QString text;
        QString title;
        Icon icon = Icon::None;
        Buttons buttons = Buttons::Ok;
        Answer answer = Answer::Ok;
    };

    Answer message(const QString &text, const QString &title, Icon icon,
                   Buttons buttons = Buttons::Ok) override;
    void setBusyPointer() override;
    void setNormalPointer() override;
    QString chooseFile(const QString &title, const QString &startPath,
                       const QString &filter) override;
    QString chooseFolder(const QString &title, const QString &startPath) override;

    void scriptAnswer(Answer answer) { m_answers.enqueue(answer); }
    void scriptChosenPath(const QString &path) { m_paths.enqueue(path); }

    const QList<Message> &messages() const { return m_messages; }
    void clearMessages() { m_messages.clear(); }
    bool isBusy() const { return m_busy; }
    // Every pointer change in order: true for busy, false for normal.
    const QList<bool> &pointerChanges() const { return m_pointerChanges; }

private:
    QList<Message> m_messages;
    QQueue<Answer> m_answers;
    QQueue<QString> m_paths;
    QList<bool> m_pointerChanges;
    bool m_busy = false;
};
