// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

// Everything the program asks of the person in front of it: message boxes, the busy pointer
// and the file and folder choosers. Core code talks only to this interface, so it never opens
// a window itself and tests can read every message and script every answer.
class Prompter
{
public:
    enum class Icon { None, Information, Exclamation, Question, Critical };
    enum class Buttons { Ok, OkCancel, YesNo, YesNoCancel, RetryCancel };
    enum class Answer { Ok, Cancel, Yes, No, Retry };

    // However much a failing server or file hands on, a message stays readable: its text
    // keeps at most this many characters and lines, its title one short line, and the rest is
    // cut with an ellipsis.
    static constexpr qsizetype MaxTextLength = 400;
    static constexpr qsizetype MaxTextLines = 12;
    static constexpr qsizetype MaxTitleLength = 100;

    virtual ~Prompter() = default;

    // Every message passes here, so no prompter can be handed an unreadable one.
    Answer message(const QString &text, const QString &title, Icon icon,
                   Buttons buttons = Buttons::Ok);

    // The text cut to the given length and number of lines, ending in "…" when cut.
    static QString capped(const QString &text, qsizetype maxLength, qsizetype maxLines);

    // Busy shows the hourglass pointer; normal restores the ordinary one, however many times
    // busy was asked for.
    virtual void setBusyPointer() = 0;
    virtual void setNormalPointer() = 0;

    // An empty result means the user cancelled.
    virtual QString chooseFile(const QString &title, const QString &startPath,
                               const QString &filter) = 0;
    virtual QString chooseFolder(const QString &title, const QString &startPath) = 0;

protected:
    virtual Answer showMessage(const QString &text, const QString &title, Icon icon,
                               Buttons buttons) = 0;
};

// Shows the busy pointer for the lifetime of the guard.
class BusyPointer
{
public:
    explicit BusyPointer(Prompter &prompter)
        : m_prompter(prompter)
    {
        m_prompter.setBusyPointer();
    }
    ~BusyPointer() { m_prompter.setNormalPointer(); }
    BusyPointer(const BusyPointer &) = delete;
    BusyPointer &operator=(const BusyPointer &) = delete;

private:
    Prompter &m_prompter;
};
