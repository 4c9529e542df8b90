// Veltrix — KPI dashboard for small businesses.
#include "useraccountsdialog.h"

#include "app/appcontext.h"
#include "views/gridview.h"

#include <QComboBox>
#include <QFormLayout>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QPainter>
#include <QPushButton>
#include <QVBoxLayout>

using namespace Qt::StringLiterals;

namespace {

// An empty box for a line the account may not see, a ticked one for a line it may.
QIcon tickIcon(bool ticked)
{
    QPixmap picture(14, 14);
    picture.fill(Qt::transparent);
    QPainter painter(&picture);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QColor(0x60, 0x60, 0x60));
    painter.setBrush(Qt::white);
    painter.drawRect(QRectF(1.5, 1.5, 11, 11));
    if (ticked) {
        painter.setPen(QPen(QColor(0x1F, 0x7A, 0x1F), 2));
        painter.drawPolyline(QPolygonF({{3.5, 7.5}, {6, 10}, {10.5, 4}}));
    }
    return QIcon(picture);
}

} // namespace

UserAccountsDialog::UserAccountsDialog(AppContext &context, QWidget *owner)
    : QDialog(owner)
    , m_accounts(context.mainDatabase(), context.prompter(), context.clock())
    , m_lstUsers(new GridView(m_accounts.users(), this))
    , m_lstFields(new GridView(m_accounts.fields(), this))
    , m_txtUsername(new QLineEdit(this))
    , m_txtPassword(new QLineEdit(this))
    , m_lstType(new QComboBox(this))
{
    setObjectName(u"frmUsers"_s);
    setWindowTitle(u" User Accounts"_s);
    m_lstUsers->setObjectName(u"lstUsers"_s);
    m_lstFields->setObjectName(u"lstFields"_s);
    m_lstFields->setIcons({tickIcon(false), tickIcon(true)});
    m_lstFields->setFittedColumn(2);
    m_txtUsername->setObjectName(u"txtUsername"_s);
    m_txtUsername->setMaxLength(UserAccounts::MaxUserNameLength);
    m_txtPassword->setObjectName(u"txtPassword"_s);
    m_txtPassword->setMaxLength(UserAccounts::MaxPasswordLength);
    m_lstType->setObjectName(u"lstType"_s);
    m_lstType->addItems({u"Standard User"_s, u"Administrator"_s});

    const std::pair<QString, QString> buttons[] = {{u"butAdd"_s, u"&Add"_s},
                                                   {u"butEdit"_s, u"&Edit"_s},
                                                   {u"butDelete"_s, u"&Delete"_s},
                                                   {u"butSaveChanges"_s, u"&Save Changes"_s},
                                                   {u"butCancelChanges"_s, u"&Cancel Changes"_s},
                                                   {u"butAll"_s, u"A&ll"_s},
                                                   {u"butNone"_s, u"&None"_s},
                                                   {u"butClose"_s, u"Close"_s}};
    for (const auto &[name, caption] : buttons) {
        auto *button = new QPushButton(caption, this);
        button->setObjectName(name);
        button->setAutoDefault(false);
    }

    auto *entry = new QFormLayout;
    entry->addRow(u"Username"_s, m_txtUsername);
    entry->addRow(u"Password"_s, m_txtPassword);
    entry->addRow(u"Account Type"_s, m_lstType);
    auto *accountButtons = new QHBoxLayout;
    for (const QString &name : {u"butAdd"_s, u"butEdit"_s, u"butDelete"_s})
        accountButtons->addWidget(button(name));
    auto *saveButtons = new QHBoxLayout;
    for (const QString &name : {u"butSaveChanges"_s, u"butCancelChanges"_s})
        saveButtons->addWidget(button(name));
    auto *left = new QVBoxLayout;
    left->addWidget(m_lstUsers, 1);
    left->addLayout(accountButtons);
    left->addLayout(entry);
    left->addLayout(saveButtons);
    auto *tickButtons = new QHBoxLayout;
    tickButtons->addWidget(button(u"butAll"_s));
    tickButtons->addWidget(button(u"butNone"_s));
    tickButtons->addStretch();
    tickButtons->addWidget(button(u"butClose"_s));
    auto *right = new QVBoxLayout;
    right->addWidget(m_lstFields, 1);
    right->addLayout(tickButtons);
    auto *layout = new QHBoxLayout(this);
    layout->addLayout(left, 3);
    layout->addLayout(right, 2);
    resize(820, 560);

    connect(&m_accounts, &UserAccounts::changed, this, &UserAccountsDialog::showState);
    connect(&m_accounts, &UserAccounts::startedAdding, this,
            [this] { m_txtUsername->setFocus(Qt::OtherFocusReason); });
    connect(m_txtUsername, &QLineEdit::textEdited, this, &UserAccountsDialog::takeEntry);
    connect(m_txtPassword, &QLineEdit::textEdited, this, &UserAccountsDialog::takeEntry);
    connect(m_lstType, &QComboBox::currentIndexChanged, this, &UserAccountsDialog::takeEntry);
    connect(&m_accounts.users(), &GridModel::selectionChanged, this, [this](int row) {
        if (!m_showing && row > 0)
            m_accounts.updateSelId(row, 0);
    });
    connect(m_lstUsers, &GridView::headerClicked, &m_accounts, &UserAccounts::headerClicked);
    connect(m_lstFields, &GridView::cellPicked, this,
            [this](int row, int) { m_accounts.toggleField(row); });
    connect(button(u"butAdd"_s), &QPushButton::clicked, &m_accounts, &UserAccounts::add);
    connect(button(u"butEdit"_s), &QPushButton::clicked, &m_accounts, &UserAccounts::edit);
    connect(button(u"butDelete"_s), &QPushButton::clicked, &m_accounts,
            &UserAccounts::deleteSelected);
    connect(button(u"butSaveChanges"_s), &QPushButton::clicked, &m_accounts,
            &UserAccounts::saveChanges);
    connect(button(u"butCancelChanges"_s), &QPushButton::clicked, &m_accounts,
            &UserAccounts::cancelChanges);
    connect(button(u"butAll"_s), &QPushButton::clicked, this,
            [this] { m_accounts.checkAllFields(UserAccounts::Ticked); });
    connect(button(u"butNone"_s), &QPushButton::clicked, this,
            [this] { m_accounts.checkAllFields(UserAccounts::Unticked); });
    connect(button(u"butClose"_s), &QPushButton::clicked, this, &QDialog::reject);

    m_accounts.load();
}

void UserAccountsDialog::showModal(AppContext &context, QWidget *owner)
{
    UserAccountsDialog dialog(context, owner);
    dialog.exec();
}

QPushButton *UserAccountsDialog::button(const QString &objectName) const
{
    return findChild<QPushButton *>(objectName, Qt::FindDirectChildrenOnly);
}

void UserAccountsDialog::takeEntry()
{
    if (m_showing)
        return;
    m_accounts.setEntry({m_txtUsername->text(), m_txtPassword->text(), m_lstType->currentIndex()});
}

void UserAccountsDialog::showState()
{
    m_showing = true;
    const UserAccounts::Entry &entry = m_accounts.entry();
    if (m_txtUsername->text() != entry.userName)
        m_txtUsername->setText(entry.userName);
    if (m_txtPassword->text() != entry.password)
        m_txtPassword->setText(entry.password);
    m_lstType->setCurrentIndex(entry.type);

    const bool editing = m_accounts.editing();
    const bool hasUsers = m_accounts.users().rowCount() > 0;
    m_lstUsers->setEnabled(!editing);
    button(u"butAdd"_s)->setEnabled(!editing);
    button(u"butEdit"_s)->setEnabled(hasUsers && !editing);
    button(u"butDelete"_s)->setEnabled(hasUsers);
    for (QWidget *control : std::initializer_list<QWidget *>{
             m_txtUsername, m_txtPassword, m_lstType, m_lstFields, button(u"butSaveChanges"_s),
             button(u"butCancelChanges"_s), button(u"butAll"_s), button(u"butNone"_s)})
        control->setEnabled(editing);
    m_showing = false;
}

void UserAccountsDialog::done(int result)
{
    if (!m_accounts.mayClose())
        return;
    QDialog::done(result);
}
