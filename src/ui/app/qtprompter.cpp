// Veltrix — KPI dashboard for small businesses.
#include "qtprompter.h"

#include <QApplication>
#include <QFileDialog>
#include <QMessageBox>

namespace {

QMessageBox::Icon boxIcon(Prompter::Icon icon)
{
    switch (icon) {
    case Prompter::Icon::Information:
        return QMessageBox::Information;
    case Prompter::Icon::Exclamation:
        return QMessageBox::Warning;
    case Prompter::Icon::Question:
        return QMessageBox::Question;
    case Prompter::Icon::Critical:
        return QMessageBox::Critical;
    case Prompter::Icon::None:
        break;
    }
    return QMessageBox::NoIcon;
}

QMessageBox::StandardButtons boxButtons(Prompter::Buttons buttons)
{
    switch (buttons) {
    case Prompter::Buttons::OkCancel:
        return QMessageBox::Ok | QMessageBox::Cancel;
    case Prompter::Buttons::YesNo:
        return QMessageBox::Yes | QMessageBox::No;
    case Prompter::Buttons::YesNoCancel:
        return QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel;
    case Prompter::Buttons::RetryCancel:
        return QMessageBox::Retry | QMessageBox::Cancel;
    case Prompter::Buttons::Ok:
        break;
    }
    return QMessageBox::Ok;
}

Prompter::Answer answerFor(int button)
{
    switch (button) {
    case QMessageBox::Cancel:
        return Prompter::Answer::Cancel;
    case QMessageBox::Yes:
        return Prompter::Answer::Yes;
    case QMessageBox::No:
        return Prompter::Answer::No;
    case QMessageBox::Retry:
        return Prompter::Answer::Retry;
    default:
        return Prompter::Answer::Ok;
    }
}

} // namespace

QtPrompter::~QtPrompter()
{
    setNormalPointer();
}

Prompter::Answer QtPrompter::showMessage(const QString &text, const QString &title, Icon icon,
                                         Buttons buttons)
{
    // Nobody can answer a question under an hourglass.
    const int busyDepth = m_busyDepth;
    for (int i = 0; i < busyDepth; ++i)
        QGuiApplication::restoreOverrideCursor();

    QMessageBox box(boxIcon(icon), title, text, boxButtons(buttons), m_parent);
    const int button = box.exec();

    for (int i = 0; i < busyDepth; ++i)
        QGuiApplication::setOverrideCursor(Qt::WaitCursor);
    return answerFor(button);
}

void QtPrompter::setBusyPointer()
{
    QGuiApplication::setOverrideCursor(Qt::WaitCursor);
    ++m_busyDepth;
}

void QtPrompter::setNormalPointer()
{
    for (; m_busyDepth > 0; --m_busyDepth)
        QGuiApplication::restoreOverrideCursor();
}

QString QtPrompter::chooseFile(const QString &title, const QString &startPath,
                               const QString &filter)
{
    return QFileDialog::getOpenFileName(m_parent, title, startPath, filter);
}

QString QtPrompter::chooseFolder(const QString &title, const QString &startPath)
{
    return QFileDialog::getExistingDirectory(m_parent, title, startPath);
}
