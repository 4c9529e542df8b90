// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "users/useraccounts.h"

#include <QDialog>

class AppContext;
class GridView;
class QComboBox;
class QLineEdit;
class QPushButton;

// frmUsers: the login accounts, with the KPI lines each may see, added, edited and deleted
// in place.
class UserAccountsDialog : public QDialog
{
    Q_OBJECT

public:
    UserAccountsDialog(AppContext &context, QWidget *owner = nullptr);

    static void showModal(AppContext &context, QWidget *owner);

    UserAccounts &accounts() { return m_accounts; }
    GridView *lstUsers() const { return m_lstUsers; }
    GridView *lstFields() const { return m_lstFields; }
    QLineEdit *txtUsername() const { return m_txtUsername; }
    QLineEdit *txtPassword() const { return m_txtPassword; }
    QComboBox *lstType() const { return m_lstType; }
    QPushButton *button(const QString &objectName) const;

    void done(int result) override;

private:
    void showState();
    void takeEntry();

    UserAccounts m_accounts;
    GridView *m_lstUsers;
    GridView *m_lstFields;
    QLineEdit *m_txtUsername;
    QLineEdit *m_txtPassword;
    QComboBox *m_lstType;
    bool m_showing = false;
};
