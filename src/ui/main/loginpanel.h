// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QWidget>

class MainDatabase;
class Prompter;
class QComboBox;
class QLineEdit;
class SettingsStore;

// picLogin: the user name box that completes names as they are typed, the password box and
// the Login button. It asks for a login; the main window decides what a login does.
class LoginPanel : public QWidget
{
    Q_OBJECT

public:
    LoginPanel(MainDatabase &database, const SettingsStore &store, Prompter &prompter,
               QWidget *parent = nullptr);

    // Fills the user name box with the stored names, showing the last user's name, or the
    // built-in account's when there are none (with a message, when asked).
    void loadUserList(bool withMessage);
    // Ready for the next user: the boxes emptied, the names reloaded, the focus on the name.
    void reset();

    QComboBox *lstUsers() const { return m_lstUsers; }
    QLineEdit *txtPassword() const { return m_txtPassword; }

Q_SIGNALS:
    void loginRequested(const QString &userName, const QString &password);

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void completeUserName(const QString &typed);
    void requestLogin();

    MainDatabase &m_database;
    const SettingsStore &m_store;
    Prompter &m_prompter;
    bool m_deletingUserName = false;
    QComboBox *m_lstUsers = nullptr;
    QLineEdit *m_txtPassword = nullptr;
};
