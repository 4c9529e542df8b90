// Veltrix — KPI dashboard for small businesses.
#include "loginpanel.h"

#include "common/prompter.h"
#include "common/settingsstore.h"
#include "database/recordoperations.h"
#include "users/loginservice.h"

#include <QComboBox>
#include <QFocusEvent>
#include <QFormLayout>
#include <QKeyEvent>
#include <QLineEdit>
#include <QPushButton>
#include <QTimer>

using namespace Qt::StringLiterals;

LoginPanel::LoginPanel(MainDatabase &database, const SettingsStore &store, Prompter &prompter,
                       QWidget *parent)
    : QWidget(parent)
    , m_database(database)
    , m_store(store)
    , m_prompter(prompter)
{
    setObjectName(u"picLogin"_s);
    m_lstUsers = new QComboBox(this);
    m_lstUsers->setObjectName(u"lstUsers"_s);
    m_lstUsers->setEditable(true);
    m_lstUsers->setInsertPolicy(QComboBox::NoInsert);
    // Typing completes to the first name that begins so, with the completed part selected so
    // that typing on replaces it; deleting (Backspace, Delete) never completes again.
    m_lstUsers->setCompleter(nullptr);
    m_lstUsers->lineEdit()->installEventFilter(this);
    connect(m_lstUsers->lineEdit(), &QLineEdit::textEdited, this, &LoginPanel::completeUserName);
    m_txtPassword = new QLineEdit(this);
    m_txtPassword->setObjectName(u"txtPassword"_s);
    m_txtPassword->setEchoMode(QLineEdit::Password);
    m_txtPassword->installEventFilter(this);
    auto *butLogin = new QPushButton(u"&Login"_s, this);
    connect(butLogin, &QPushButton::clicked, this, &LoginPanel::requestLogin);
    connect(m_txtPassword, &QLineEdit::returnPressed, this, &LoginPanel::requestLogin);

    auto *form = new QFormLayout(this);
    form->addRow(u"Username"_s, m_lstUsers);
    form->addRow(u"Password"_s, m_txtPassword);
    form->addRow(QString(), butLogin);
    setFixedWidth(320);
}

void LoginPanel::loadUserList(bool withMessage)
{
    RecordOperations::ListContent names;
    RecordOperations(m_database, m_prompter)
        .loadList(names, u"Users"_s, u"Username"_s, QString(), false);
    m_lstUsers->clear();
    m_lstUsers->addItems(names.items);
    if (!names.items.isEmpty()) {
        m_lstUsers->setEditText(m_store.readSetting(u"LastUser"_s));
        return;
    }
    m_lstUsers->setEditText(LoginService::BuiltInUser);
    if (withMessage) {
        m_prompter.message(u"There are no users added to the database. Please contact the "
                           u"Administrator"_s,
                           u"No Users"_s, Prompter::Icon::Information);
    }
}

void LoginPanel::reset()
{
    m_lstUsers->clearEditText();
    m_txtPassword->clear();
    loadUserList(false);
    m_lstUsers->setFocus();
}

void LoginPanel::completeUserName(const QString &typed)
{
    if (m_deletingUserName || typed.isEmpty())
        return;
    for (int i = 0; i < m_lstUsers->count(); ++i) {
        const QString name = m_lstUsers->itemText(i);
        if (!name.isEmpty() && name.startsWith(typed, Qt::CaseInsensitive)) {
            QLineEdit *box = m_lstUsers->lineEdit();
            box->setText(name);
            box->setSelection(int(typed.size()), int(name.size() - typed.size()));
            return;
        }
    }
}

void LoginPanel::requestLogin()
{
    Q_EMIT loginRequested(m_lstUsers->currentText(), m_txtPassword->text());
}

bool LoginPanel::eventFilter(QObject *watched, QEvent *event)
{
    if (watched == m_lstUsers->lineEdit() && event->type() == QEvent::KeyPress) {
        const int key = static_cast<QKeyEvent *>(event)->key();
        m_deletingUserName = key == Qt::Key_Backspace || key == Qt::Key_Delete;
    }
    if (watched == m_txtPassword && event->type() == QEvent::FocusIn) {
        // Keyboard focus selects the password for retyping; a click places the caret.
        if (static_cast<QFocusEvent *>(event)->reason() != Qt::MouseFocusReason)
            QTimer::singleShot(0, m_txtPassword, &QLineEdit::selectAll);
    }
    return QWidget::eventFilter(watched, event);
}
