// Veltrix — KPI dashboard for small businesses.
#include "testworkspace.h"

#include "grid/gridoperations.h"
#include "users/loginservice.h"
#include "users/useraccountsdialog.h"
#include "views/gridview.h"

#include <QComboBox>
#include <QHeaderView>
#include <QLineEdit>
#include <QPushButton>
#include <QTest>

using namespace Qt::StringLiterals;

namespace {

const QDateTime Now(QDate(2026, 12, 6), QTime(14, 5));

} // namespace

class TestUserAccountsDialog : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();
    void opensOnTheFirstNameWithItsTicks();
    void addingAnAccount_data();
    void addingAnAccount();
    void ticksSavedThenAccountDeletedWhileEdited();
    void closingWhileEditingAsks_data();
    void closingWhileEditingAsks();

private:
    void addUser(const QString &name, const QString &password, int type, const QString &fields)
    {
        QVERIFY(m_workspace->exec(u"INSERT INTO Users (UserName, Password, Type, DateCreated, "
                                  u"Fields) VALUES (?, ?, ?, '1 Jan 2026 9:00 AM', ?)"_s,
                                  {name, password, type, fields}));
    }
    // Password, type, date created and ticks of the account of exactly that name; empty when
    // there is none.
    QStringList stored(const QString &name)
    {
        const QString row = m_workspace
                                ->value(u"SELECT Password || '|' || Type || '|' || DateCreated || "
                                        u"'|' || Fields FROM Users WHERE UserName = ?"_s,
                                        {name})
                                .toString();
        return row.isEmpty() ? QStringList() : row.split(u'|');
    }
    int userCount() { return m_workspace->value(u"SELECT COUNT(*) FROM Users"_s).toInt(); }
    int rowOfUser(UserAccountsDialog &dialog, const QString &name)
    {
        return GridOperations::findGridRow(dialog.accounts().users(), 2, name);
    }
    // Ticks of the KPI lines, by Field ID.
    QStringList ticked(UserAccountsDialog &dialog)
    {
        QStringList ids;
        const GridModel &fields = dialog.accounts().fields();
        for (int row = 1; row <= fields.rowCount(); ++row) {
            if (fields.cell(row, 2).icon == UserAccounts::Ticked)
                ids << fields.cellText(row, 1);
        }
        return ids;
    }
    void clickLine(UserAccountsDialog &dialog, const QString &id)
    {
        const int row = GridOperations::findGridRow(dialog.accounts().fields(), 1, id);
        QVERIFY(row > 0);
        const QRect cell = dialog.lstFields()->cellRect(row, 2);
        QTest::mouseClick(dialog.lstFields()->viewport(), Qt::LeftButton, {}, cell.center());
    }
    void type(QLineEdit *box, const QString &text)
    {
        box->selectAll();
        QTest::keyClick(box, Qt::Key_Delete);
        QTest::keyClicks(box, text);
    }
    QString lastMessage() const
    {
        const auto &messages = m_workspace->prompter().messages();
        return messages.isEmpty() ? QString() : messages.last().text;
    }

    std::unique_ptr<TestWorkspace> m_workspace;
};

void TestUserAccountsDialog::init()
{
    m_workspace = std::make_unique<TestWorkspace>(Clock::fixedAt(Now));
    QVERIFY(m_workspace->configure());
    QVERIFY(m_workspace->connect());
    addUser(u"Bob"_s, u"bob1"_s, 0, u"1,2,3#13"_s);
    addUser(u"Anna"_s, u"anna1"_s, 1, u"1,999,#2"_s);
    m_workspace->prompter().clearMessages();
}

void TestUserAccountsDialog::cleanup()
{
    disconnectMainDatabase(m_workspace->context());
    m_workspace.reset();
}

void TestUserAccountsDialog::opensOnTheFirstNameWithItsTicks()
{
    UserAccountsDialog dialog(m_workspace->context());
    QCOMPARE(dialog.windowTitle(), u" User Accounts"_s);
    QCOMPARE(dialog.accounts().users().rowCount(), 2);
    QCOMPARE(dialog.accounts().users().cellText(1, 2), u"Anna"_s); // sorted by name
    QCOMPARE(dialog.txtUsername()->text(), u"Anna"_s);
    QCOMPARE(dialog.txtPassword()->text(), u"anna1"_s);
    QCOMPARE(dialog.lstType()->currentText(), u"Administrator"_s);
    // 999 is no longer listed: the other ticks show without complaint.
    QCOMPARE(ticked(dialog), (QStringList{u"1"_s, u"2"_s}));
    QVERIFY(!dialog.txtUsername()->isEnabled());
    QVERIFY(!dialog.button(u"butSaveChanges"_s)->isEnabled());
    QVERIFY(dialog.button(u"butEdit"_s)->isEnabled());
    QCOMPARE(dialog.txtUsername()->maxLength(), 16);
    QCOMPARE(dialog.txtPassword()->maxLength(), 8);

    dialog.accounts().selectUser(rowOfUser(dialog, u"Bob"_s));
    QCOMPARE(dialog.txtUsername()->text(), u"Bob"_s);
    QCOMPARE(ticked(dialog), (QStringList{u"1"_s, u"2"_s, u"3"_s, u"13"_s}));

    // A click on the name header sorts the other way, the next one back.
    dialog.show();
    QHeaderView *header = dialog.lstUsers()->horizontalHeader();
    const QPoint username(header->sectionViewportPosition(1) + 5, header->height() / 2);
    QTest::mouseClick(header->viewport(), Qt::LeftButton, {}, username);
    QCOMPARE(dialog.accounts().users().cellText(1, 2), u"Bob"_s);
    QTest::mouseClick(header->viewport(), Qt::LeftButton, {}, username);
    QCOMPARE(dialog.accounts().users().cellText(1, 2), u"Anna"_s);
}

void TestUserAccountsDialog::addingAnAccount_data()
{
    QTest::addColumn<QString>("name");
    QTest::addColumn<QString>("password");
    QTest::addColumn<QString>("reason"); // the save is refused for; empty when it logs in
    QTest::newRow("bob when Bob exists")
        << u"bob"_s << u"pw"_s << u"That username already exists"_s;
    QTest::newRow("name of spaces") << u"   "_s << u"pw"_s << u"You must specify the Username!"_s;
    QTest::newRow("no password") << u"Carl"_s << u"  "_s << u"You must specify the Password!"_s;
    QTest::newRow("apostrophe") << u"O'Brien"_s << u"it's"_s << QString();
    QTest::newRow("percent") << u"50% Panel"_s << u"100%"_s << QString();
    QTest::newRow("trailing space") << u"Carl "_s << u"carl1"_s << QString();
    QTest::newRow("quote and underscore") << u"\"Max\"_2"_s << u"m_x"_s << QString();
}

void TestUserAccountsDialog::addingAnAccount()
{
    QFETCH(QString, name);
    QFETCH(QString, password);
    QFETCH(QString, reason);
    UserAccountsDialog dialog(m_workspace->context());
    dialog.button(u"butAdd"_s)->click();
    QVERIFY(dialog.txtUsername()->isEnabled());
    QVERIFY(!dialog.lstUsers()->isEnabled());
    QCOMPARE(ticked(dialog), QStringList());
    type(dialog.txtUsername(), name);
    type(dialog.txtPassword(), password);
    dialog.lstType()->setCurrentIndex(1);
    clickLine(dialog, u"2"_s);
    clickLine(dialog, u"13"_s);
    clickLine(dialog, u"2"_s); // and off again
    clickLine(dialog, u"1"_s);
    dialog.button(u"butSaveChanges"_s)->click();

    if (!reason.isEmpty()) {
        QCOMPARE(lastMessage(), reason + u"\r\n\r\nChanges to the user have not been saved!"_s);
        QCOMPARE(m_workspace->prompter().messages().last().title, u"Cannot Save"_s);
        QCOMPARE(m_workspace->prompter().messages().last().icon, Prompter::Icon::Exclamation);
        // Still adding, so that the entry can be corrected.
        QCOMPARE(dialog.accounts().mode(), UserAccounts::Mode::Adding);
        QVERIFY(dialog.txtUsername()->isEnabled());
        QCOMPARE(userCount(), 2);
        return;
    }
    QVERIFY2(m_workspace->prompter().messages().isEmpty(), qPrintable(lastMessage()));
    QCOMPARE(dialog.accounts().mode(), UserAccounts::Mode::Browsing);
    QVERIFY(!dialog.txtUsername()->isEnabled());
    // The ticks in list order.
    QCOMPARE(stored(name), (QStringList{password, u"1"_s, u"6 Dec 2026 2:05 PM"_s, u"1,13"_s}));
    // The new account is the one shown.
    QCOMPARE(dialog.txtUsername()->text(), name);

    const std::optional<LoginState> login =
        LoginService::checkCredentials(m_workspace->context().mainDatabase(), name, password);
    QVERIFY(login);
    QCOMPARE(login->currentUser, name);
    QCOMPARE(login->currentUserFields, u"1,13"_s);
}

void TestUserAccountsDialog::ticksSavedThenAccountDeletedWhileEdited()
{
    UserAccountsDialog dialog(m_workspace->context());
    dialog.button(u"butEdit"_s)->click();
    type(dialog.txtUsername(), u"Changed"_s);
    dialog.button(u"butAll"_s)->click();
    const GridModel &fields = dialog.accounts().fields();
    int headings = 0;
    for (int row = 1; row <= fields.rowCount(); ++row) {
        const bool heading = fields.cell(row, 2).back == QColor(0xDD, 0x68, 0x00);
        headings += heading ? 1 : 0;
        QCOMPARE(fields.cell(row, 2).icon,
                 heading ? int(UserAccounts::NoIcon) : int(UserAccounts::Ticked));
    }
    QVERIFY(headings > 3);
    QCOMPARE(ticked(dialog).size(), fields.rowCount() - headings);
    // Cancel shows the stored values again.
    dialog.button(u"butCancelChanges"_s)->click();
    QCOMPARE(dialog.txtUsername()->text(), u"Anna"_s);
    QCOMPARE(ticked(dialog), (QStringList{u"1"_s, u"2"_s}));
    QCOMPARE(stored(u"Anna"_s).value(3), u"1,999,#2"_s);

    // No ticks at all are stored as "#" and read back as none.
    dialog.button(u"butEdit"_s)->click();
    dialog.button(u"butNone"_s)->click();
    QCOMPARE(ticked(dialog), QStringList());
    dialog.button(u"butSaveChanges"_s)->click();
    QCOMPARE(stored(u"Anna"_s).value(3), u"#"_s);
    UserAccountsDialog again(m_workspace->context());
    QCOMPARE(again.txtUsername()->text(), u"Anna"_s);
    QCOMPARE(ticked(again), QStringList());

    // An account deleted while it is edited is not brought back by the save.
    again.accounts().selectUser(rowOfUser(again, u"Bob"_s));
    again.button(u"butEdit"_s)->click();
    QVERIFY(again.button(u"butDelete"_s)->isEnabled());
    m_workspace->prompter().scriptAnswer(Prompter::Answer::Yes);
    again.button(u"butDelete"_s)->click();
    QVERIFY(lastMessage().startsWith(u"Are you sure you want to delete the record with ID "_s));
    QCOMPARE(stored(u"Bob"_s), QStringList());
    again.button(u"butSaveChanges"_s)->click();
    QCOMPARE(lastMessage(), u"This user account doesn't exist. It may have been deleted!\r\n\r\n"
                            u"Changes to the user have not been saved!"_s);
    QCOMPARE(stored(u"Bob"_s), QStringList());
    QCOMPARE(userCount(), 1);
    // Nothing is left to edit: closing does not ask about it.
    QVERIFY(!again.txtUsername()->isEnabled());
    const qsizetype before = m_workspace->prompter().messages().size();
    again.button(u"butClose"_s)->click();
    QCOMPARE(m_workspace->prompter().messages().size(), before);
}

void TestUserAccountsDialog::closingWhileEditingAsks_data()
{
    QTest::addColumn<int>("answer");
    QTest::addColumn<bool>("closes");
    QTest::addColumn<int>("bobs");      // accounts named Bob afterwards
    QTest::addColumn<QString>("stamp"); // the latest DateCreated of those
    const QString before = u"1 Jan 2026 9:00 AM"_s;
    QTest::newRow("cancel") << int(Prompter::Answer::Cancel) << false << 1 << before;
    QTest::newRow("no") << int(Prompter::Answer::No) << true << 1 << before;
    // An edit may take another account's name; saving stamps it with the moment of the save.
    QTest::newRow("yes") << int(Prompter::Answer::Yes) << true << 2 << u"6 Dec 2026 2:05 PM"_s;
}

void TestUserAccountsDialog::closingWhileEditingAsks()
{
    QFETCH(int, answer);
    QFETCH(bool, closes);
    QFETCH(int, bobs);
    QFETCH(QString, stamp);
    UserAccountsDialog dialog(m_workspace->context());
    dialog.show();
    dialog.button(u"butEdit"_s)->click();
    QCOMPARE(dialog.accounts().mode(), UserAccounts::Mode::Editing);
    type(dialog.txtUsername(), u"Bob"_s);
    m_workspace->prompter().scriptAnswer(Prompter::Answer(answer));
    dialog.button(u"butClose"_s)->click();
    QCOMPARE(m_workspace->prompter().messages().size(), 1);
    const auto &question = m_workspace->prompter().messages().first();
    QCOMPARE(question.text, u"Would you like to save changes to the user before closing?"_s);
    QCOMPARE(question.title, u"Save Changes"_s);
    QCOMPARE(question.buttons, Prompter::Buttons::YesNoCancel);
    QCOMPARE(dialog.isVisible(), !closes);
    QCOMPARE(m_workspace->value(u"SELECT COUNT(*) FROM Users WHERE UserName = 'Bob'"_s).toInt(),
             bobs);
    QCOMPARE(m_workspace->value(u"SELECT MAX(DateCreated) FROM Users WHERE UserName = 'Bob'"_s)
                 .toString(),
             stamp);
}

QTEST_MAIN(TestUserAccountsDialog)
#include "tst_useraccountsdialog.moc"
