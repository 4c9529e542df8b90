// Veltrix — KPI dashboard for small businesses.
#include "recordingprompter.h"

namespace {

Prompter::Answer defaultAnswer(Prompter::Buttons buttons)
{
    switch (buttons) {
    case Prompter::Buttons::YesNo:
    case Prompter::Buttons::YesNoCancel:
        return Prompter::Answer::Yes;
    case Prompter::Buttons::RetryCancel:
        return Prompter::Answer::Retry;
    case Prompter::Buttons::Ok:
    case Prompter::Buttons::OkCancel:
        break;
    }
    return Prompter::Answer::Ok;
}

} // namespace

Prompter::Answer RecordingPrompter::showMessage(const QString &text, const QString &title,
                                                Icon icon, Buttons buttons)
{
    const Answer answer = m_answers.isEmpty() ? defaultAnswer(buttons) : m_answers.dequeue();
    m_messages.append({text, title, icon, buttons, answer});
    if (m_whileShown)
        m_whileShown(m_messages.last());
    return answer;
}

void RecordingPrompter::setBusyPointer()
{
    m_busy = true;
    m_pointerChanges.append(true);
}

void RecordingPrompter::setNormalPointer()
{
    m_busy = false;
    m_pointerChanges.append(false);
}

QString RecordingPrompter::chooseFile(const QString &, const QString &, const QString &)
{
    return m_paths.isEmpty() ? QString() : m_paths.dequeue();
}

QString RecordingPrompter::chooseFolder(const QString &, const QString &)
{
    return m_paths.isEmpty() ? QString() : m_paths.dequeue();
}
