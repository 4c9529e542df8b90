// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QDialog>

class AppContext;
class QLabel;
class QPushButton;
class QTimer;
class Prompter;

// frmSplash: shown first, it runs start-up half a second after it appears. On success it hands
// over to the main window; on failure it shows why in red and offers the configuration dialog
// or, when a newer program or database is needed, the update page. The main window reuses it
// as its About window.
class LoadingWindow : public QDialog
{
    Q_OBJECT

public:
    LoadingWindow(AppContext &context, Prompter &prompter, QWidget *parent = nullptr);

    // Shows the versions modally over the owner, with a Close button and no start-up.
    static void showAbout(AppContext &context, Prompter &prompter, QWidget *owner);

    // Starts the half-second wait before start-up runs.
    void startLoading();
    // The start-up sequence, as the timer runs it.
    void runSequence();

    QLabel *lblVersion() const { return m_lblVersion; }
    QLabel *lblDBVersion() const { return m_lblDBVersion; }
    QLabel *lblStatus() const { return m_lblStatus; }
    QPushButton *butOptions() const { return m_butOptions; }
    QPushButton *butUpdate() const { return m_butUpdate; }
    QPushButton *butClose() const { return m_butClose; }
    QTimer *tmrLoad() const { return m_tmrLoad; }

Q_SIGNALS:
    // Start-up succeeded: the main window takes over; this window closes itself.
    void startupSucceeded();

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void buildLayout();
    void finishLoading(bool failed, bool updateNeeded);
    void openOptions();
    void openUpdatePage();
    void centreLogo();

    AppContext &m_context;
    Prompter &m_prompter;

    QWidget *m_picTop = nullptr;
    QLabel *m_imgLogo = nullptr;
    QLabel *m_lblVersion = nullptr;
    QLabel *m_lblDBVersion = nullptr;
    QLabel *m_lblStatus = nullptr;
    QPushButton *m_butOptions = nullptr;
    QPushButton *m_butUpdate = nullptr;
    QPushButton *m_butClose = nullptr;
    QTimer *m_tmrLoad = nullptr;
};
