// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "app/systemconfiguration.h"

#include <QDialog>

class QButtonGroup;
class QComboBox;
class QLineEdit;
class QRadioButton;
class QToolButton;
class QPushButton;
class Prompter;
class SettingsStore;

// frmConfig: where the database lives, which accounting package is used, its data file and,
// for MYOB, the driver and the login.
class ConfigDialog : public QDialog
{
    Q_OBJECT

public:
    ConfigDialog(SettingsStore &store, Prompter &prompter, QWidget *parent = nullptr);

    // Shows the dialog modally; true when the settings were saved.
    static bool modify(QWidget *owner, SettingsStore &store, Prompter &prompter);

    bool saved() const { return m_saved; }
    QString packageName() const { return m_packageName; }

    // The controls, by the names the rest of the program and its tests know them.
    QLineEdit *txtDBPath() const { return m_txtDBPath; }
    QRadioButton *optAccPackage(int index) const;
    QLineEdit *txtAccFilePath() const { return m_txtAccFilePath; }
    QWidget *picLogin() const { return m_picLogin; }
    QComboBox *lstDriver() const { return m_lstDriver; }
    QWidget *driverRow() const { return m_driverRow; }
    QLineEdit *txtAccUsername() const { return m_txtAccUsername; }
    QLineEdit *txtAccPassword() const { return m_txtAccPassword; }
    QPushButton *butOK() const { return m_butOK; }
    QToolButton *butBrowsePath() const { return m_butBrowsePath; }
    QToolButton *butBrowseFile() const { return m_butBrowseFile; }

private:
    void buildLayout();
    void loadValues();
    void selectPackage(int index);
    void browsePath();
    void browseFile();
    void accept() override;

    SystemConfiguration m_configuration;
    Prompter &m_prompter;
    QString m_packageName;
    QString m_fileFilter;
    bool m_saved = false;

    QLineEdit *m_txtDBPath = nullptr;
    QToolButton *m_butBrowsePath = nullptr;
    QButtonGroup *m_optAccPackage = nullptr;
    QLineEdit *m_txtAccFilePath = nullptr;
    QToolButton *m_butBrowseFile = nullptr;
    QWidget *m_picLogin = nullptr;
    QWidget *m_driverRow = nullptr;
    QComboBox *m_lstDriver = nullptr;
    QLineEdit *m_txtAccUsername = nullptr;
    QLineEdit *m_txtAccPassword = nullptr;
    QPushButton *m_butOK = nullptr;
    QPushButton *m_butCancel = nullptr;
};
