// Veltrix — KPI dashboard for small businesses.
#include "configdialog.h"

#include "common/prompter.h"

#include <QButtonGroup>
#include <QComboBox>
#include <QDialogButtonBox>
#include <QFileInfo>
#include <QFormLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QStyle>
#include <QToolButton>
#include <QVBoxLayout>

using namespace Qt::StringLiterals;

namespace {

const QString PackageCaptions[] = {u"MoneyWorks"_s, u"MYOB"_s};

QToolButton *browseButton(QWidget *parent, const QString &tip)
{
    auto *button = new QToolButton(parent);
    button->setIcon(parent->style()->standardIcon(QStyle::SP_DirOpenIcon));
    button->setToolTip(tip);
    return button;
}

} // namespace

ConfigDialog::ConfigDialog(SettingsStore &store, Prompter &prompter, QWidget *parent)
    : QDialog(parent)
    , m_configuration(store, prompter)
    , m_prompter(prompter)
{
    setObjectName(u"frmConfig"_s);
    setWindowTitle(u" System Configuration"_s);
    buildLayout();
    loadValues();
}

bool ConfigDialog::modify(QWidget *owner, SettingsStore &store, Prompter &prompter)
{
    ConfigDialog dialog(store, prompter, owner);
    dialog.exec();
    return dialog.saved();
}

QRadioButton *ConfigDialog::optAccPackage(int index) const
{
    return qobject_cast<QRadioButton *>(m_optAccPackage->button(index));
}

void ConfigDialog::buildLayout()
{
    auto *banner = new QLabel(u"Configure the environment and data paths"_s, this);
    QFont bannerFont = banner->font();
    bannerFont.setBold(true);
    bannerFont.setPointSizeF(bannerFont.pointSizeF() * 1.2);
    banner->setFont(bannerFont);

    m_txtDBPath = new QLineEdit(this);
    m_txtDBPath->setObjectName(u"txtDBPath"_s);
    m_butBrowsePath = browseButton(this, u"Choose the folder that contains the main.db file"_s);
    m_butBrowsePath->setObjectName(u"butBrowsePath"_s);
    auto *pathRow = new QHBoxLayout;
    pathRow->addWidget(m_txtDBPath);
    pathRow->addWidget(m_butBrowsePath);

    m_optAccPackage = new QButtonGroup(this);
    auto *packageRow = new QHBoxLayout;
    for (int index = 0; index < 2; ++index) {
        auto *option = new QRadioButton(PackageCaptions[index], this);
        option->setObjectName(u"optAccPackage%1"_s.arg(index));
        m_optAccPackage->addButton(option, index);
        packageRow->addWidget(option);
    }
    packageRow->addStretch();
    connect(m_optAccPackage, &QButtonGroup::idClicked, this, &ConfigDialog::selectPackage);

    m_txtAccFilePath = new QLineEdit(this);
    m_txtAccFilePath->setObjectName(u"txtAccFilePath"_s);
    m_butBrowseFile = browseButton(this, u"Choose your primary Accounting data file"_s);
    m_butBrowseFile->setObjectName(u"butBrowseFile"_s);
    auto *fileRow = new QHBoxLayout;
    fileRow->addWidget(m_txtAccFilePath);
    fileRow->addWidget(m_butBrowseFile);

    m_picLogin = new QGroupBox(u"Login"_s, this);
    m_picLogin->setObjectName(u"picLogin"_s);
    m_driverRow = new QWidget(m_picLogin);
    m_lstDriver = new QComboBox(m_driverRow);
    m_lstDriver->setObjectName(u"lstDriver"_s);
    m_lstDriver->setEditable(true);
    m_lstDriver->addItems(SystemConfiguration::driverNames());
    auto *driverHint =
        new QLabel(u"(this driver must exist in the ODBC drivers list)"_s, m_driverRow);
    driverHint->setEnabled(false);
    auto *driverForm = new QFormLayout(m_driverRow);
    driverForm->setContentsMargins(0, 0, 0, 0);
    driverForm->addRow(u"Driver"_s, m_lstDriver);
    driverForm->addRow(QString(), driverHint);

    m_txtAccUsername = new QLineEdit(m_picLogin);
    m_txtAccUsername->setObjectName(u"txtAccUsername"_s);
    m_txtAccPassword = new QLineEdit(m_picLogin);
    m_txtAccPassword->setObjectName(u"txtAccPassword"_s);
    m_txtAccPassword->setEchoMode(QLineEdit::Password);
    auto *loginForm = new QFormLayout(m_picLogin);
    loginForm->addRow(m_driverRow);
    loginForm->addRow(u"Username"_s, m_txtAccUsername);
    loginForm->addRow(u"Password"_s, m_txtAccPassword);
    m_picLogin->setVisible(false);

    auto *buttons = new QDialogButtonBox(this);
    m_butOK = buttons->addButton(u"O&K"_s, QDialogButtonBox::AcceptRole);
    m_butOK->setObjectName(u"butOK"_s);
    m_butCancel = buttons->addButton(u"Cancel"_s, QDialogButtonBox::RejectRole);
    m_butCancel->setObjectName(u"butCancel"_s);
    connect(buttons, &QDialogButtonBox::accepted, this, &ConfigDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &ConfigDialog::reject);
    connect(m_butBrowsePath, &QToolButton::clicked, this, &ConfigDialog::browsePath);
    connect(m_butBrowseFile, &QToolButton::clicked, this, &ConfigDialog::browseFile);

    auto *layout = new QVBoxLayout(this);
    layout->addWidget(banner);
    layout->addWidget(new QLabel(u"Folder path to database \"main.db\""_s, this));
    layout->addLayout(pathRow);
    layout->addWidget(new QLabel(u"Choose your Accounting package"_s, this));
    layout->addLayout(packageRow);
    layout->addWidget(new QLabel(u"Accounting data file path"_s, this));
    layout->addLayout(fileRow);
    layout->addWidget(m_picLogin);
    layout->addStretch();
    layout->addWidget(buttons);
    setMinimumWidth(460);
}

void ConfigDialog::loadValues()
{
    const SystemConfiguration::Values values = m_configuration.load();
    m_txtDBPath->setText(values.dbPath);
    m_packageName = values.package;
    m_txtAccFilePath->setText(values.accFilePath);
    m_lstDriver->setEditText(values.driver);
    m_txtAccUsername->setText(values.user);
    m_txtAccPassword->setText(values.password);
    for (int index = 0; index < 2; ++index) {
        if (m_packageName == PackageCaptions[index]) {
            optAccPackage(index)->setChecked(true);
            selectPackage(index);
        }
    }
}

void ConfigDialog::selectPackage(int index)
{
    m_packageName = PackageCaptions[index];
    // A MoneyWorks server asks for a login too; only MYOB needs a driver.
    m_picLogin->setVisible(true);
    m_driverRow->setVisible(m_packageName == u"MYOB"_s);
    m_fileFilter = SystemConfiguration::fileFilter(m_packageName);
}

void ConfigDialog::browsePath()
{
    const QString chosen = m_prompter.chooseFolder(u"Select A Directory"_s, m_txtDBPath->text());
    if (!chosen.isEmpty())
        m_txtDBPath->setText(chosen);
}

void ConfigDialog::browseFile()
{
    const QString chosen = m_prompter.chooseFile(u"Choose your primary Accounting data file"_s,
                                                 m_txtAccFilePath->text(), m_fileFilter);
    if (!chosen.isEmpty())
        m_txtAccFilePath->setText(QFileInfo(chosen).absoluteFilePath());
}

void ConfigDialog::accept()
{
    SystemConfiguration::Values values{m_txtDBPath->text(),      m_packageName,
                                       m_txtAccFilePath->text(), m_lstDriver->currentText(),
                                       m_txtAccUsername->text(), m_txtAccPassword->text()};
    const bool saved = m_configuration.save(values);
    m_txtDBPath->setText(values.dbPath);
    if (!saved)
        return;
    m_saved = true;
    QDialog::accept();
}
