// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "prompter.h"

#include <QList>
#include <QQueue>

#include <functional>

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

    void setBusyPointer() override;
    void setNormalPointer() override;
    QString chooseFile(const QString &title, const QString &startPath,
                       const QString &filter) override;
    QString chooseFolder(const QString &title, const QString &startPath) override;

    void scriptAnswer(Answer answer) { m_answers.enqueue(answer); }
    void scriptChosenPath(const QString &path) { m_paths.enqueue(path); }
    // Runs while a message is shown, as a real box runs its own event loop until it closes.
    void setWhileShown(std::function<void(const Message &)> action)
    {
        m_whileShown = std::move(action);
    }

    const QList<Message> &messages() const { return m_messages; }
    void clearMessages() { m_messages.clear(); }
    bool isBusy() const { return m_busy; }
    // Every pointer change in order: true for busy, false for normal.
    const QList<bool> &pointerChanges() const { return m_pointerChanges; }

protected:
    Answer showMessage(const QString &text, const QString &title, Icon icon,
                       Buttons buttons) override;

private:
    QList<Message> m_messages;
    QQueue<Answer> m_answers;
    QQueue<QString> m_paths;
    QList<bool> m_pointerChanges;
    std::function<void(const Message &)> m_whileShown;
    bool m_busy = false;
};
