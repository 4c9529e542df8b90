// Veltrix — KPI dashboard for small businesses.
#include "useraccounts.h"

#include "common/clock.h"
#include "common/errorreporter.h"
#include "common/prompter.h"
#include "database/maindatabase.h"
#include "database/recordoperations.h"
#include "grid/gridoperations.h"

using namespace Qt::StringLiterals;
using namespace GridOperations;

namespace {

constexpr int IdColumn = 1;
constexpr int PasswordColumn = 3;
constexpr int TypeColumn = 4;
constexpr int FieldsColumn = 6;
constexpr int FieldLabelColumn = 2;

const QString CannotSave = u"Cannot Save"_s;

} // namespace

UserAccounts::UserAccounts(MainDatabase &database, Prompter &prompter, const Clock &clock,
                           QObject *parent)
    : QObject(parent)
    , m_database(database)
    , m_prompter(prompter)
    , m_clock(clock)
{}

void UserAccounts::load()
{
    m_users.addColumn(u"id"_s, u"ID"_s, GridModel::AlignLeft, 0, true);
    m_users.addColumn(u"username"_s, u"Username"_s, GridModel::AlignLeft, 100, true);
    m_users.addColumn(u"password"_s, QString(), GridModel::AlignLeft, 80, false);
    m_users.addColumn(u"type"_s, u"Type"_s, GridModel::AlignLeft, 50, true);
    m_users.addColumn(u"datecreated"_s, u"Date Created"_s, GridModel::AlignLeft, 130, true);
    m_users.addColumn(u"fields"_s, QString(), GridModel::AlignLeft, 80, false);
    setupGrid(m_users);
    m_fields.addColumn(u"id"_s, QString(), GridModel::AlignLeft, 0, false);
    m_fields.addColumn(u"field"_s, u"Fields"_s, GridModel::AlignLeft, 200, true);
    setupGrid(m_fields);

    fillFieldList();
    m_sortColumn = UserNameColumn;
    m_sortAscending = true;
    m_mode = Mode::Browsing;
    refreshForm(true);
    setEditMode(false);
}

void UserAccounts::fillFieldList()
{
    RecordSet &records = m_database.fieldsRecordset();
    m_fields.setRedraw(false);
    m_fields.clear();
    if (!records.moveFirst()) {
        for (; !records.eof(); records.moveNext()) {
            const int row = m_fields.addRow();
            m_fields.setCellText(row, IdColumn, records.value(u"ID"_s).toString());
            m_fields.setCellText(row, FieldLabelColumn, records.value(u"Label"_s).toString());
            if (records.value(u"Type"_s).toInt() == 1) {
                setHeadingStyle(m_fields, row, FieldLabelColumn);
                m_fields.editCell(row, FieldLabelColumn).icon = NoIcon;
            } else {
                m_fields.editCell(row, FieldLabelColumn).icon = Unticked;
            }
        }
    }
    m_fields.setRedraw(true);
}

void UserAccounts::refreshForm(bool requery)
{
    if (requery) {
        const qint64 remembered = m_selectedUserId;
        RecordSet &records = m_database.usersRecordset();
        if (const std::optional<DbError> failure = records.requery()) {
            ErrorReporter(m_prompter)
                .reportError(failure->number, failure->description, u"Refresh Form"_s);
            return;
        }
        fillGrid(m_users, records, false);
        sortGrid(m_users, m_sortColumn, m_sortAscending);
        selectRowById(m_users, remembered);
    } else {
        sortGrid(m_users, m_sortColumn, m_sortAscending);
    }
    updateSelId(0, 0);
}

void UserAccounts::updateSelId(int row, qint64 id)
{
    // While an account is being added or edited the boxes keep what was typed and the edit
    // keeps its account, even when the list is read again (after a delete, say): the edit
    // must never be saved into whichever account the list selects next.
    if (m_editing) {
        Q_EMIT changed();
        return;
    }
    if (row == 0)
        row = m_users.selectedRow();
    if (id < 1)
        m_selectedUserId = row > 0 ? m_users.cellText(row, IdColumn).toLongLong() : 0;
    else
        m_selectedUserId = id;
    if (row > 0 && row <= m_users.rowCount() && m_selectedUserId > 0) {
        m_entry.userName = m_users.cellText(row, UserNameColumn);
        m_entry.password = m_users.cellText(row, PasswordColumn);
        m_entry.type = std::clamp(m_users.cellText(row, TypeColumn).toInt(), 0, 1);
        checkAllFields(Unticked);
        const QStringList groups = m_users.cellText(row, FieldsColumn).split(u'#');
        for (const QString &group : groups) {
            for (const QString &id : group.split(u',')) {
                // Lines that are no longer listed are passed over.
                if (const int line = findGridRow(m_fields, IdColumn, id); line > 0)
                    m_fields.editCell(line, FieldLabelColumn).icon = Ticked;
            }
        }
    }
    Q_EMIT changed();
}

void UserAccounts::selectUser(int row)
{
    if (row < 1)
        return;
    m_users.setSelectedRow(row);
    updateSelId(row, 0);
}

void UserAccounts::headerClicked(int column)
{
    if (column == m_sortColumn) {
        m_sortAscending = !m_sortAscending;
    } else {
        m_sortColumn = column;
        m_sortAscending = true;
    }
    sortGrid(m_users, m_sortColumn, m_sortAscending);
    Q_EMIT changed();
}

void UserAccounts::setEditMode(bool editing)
{
    m_editing = editing;
    Q_EMIT changed();
}

void UserAccounts::add()
{
    m_mode = Mode::Adding;
    setEditMode(true);
    checkAllFields(Unticked);
    m_entry = Entry{};
    Q_EMIT changed();
    Q_EMIT startedAdding();
}

void UserAccounts::edit()
{
    if (m_selectedUserId <= 0)
        return;
    m_mode = Mode::Editing;
    setEditMode(true);
}

void UserAccounts::deleteSelected()
{
    MainDatabase &database = m_database;
    if (RecordOperations(database, m_prompter)
            .deleteRecordById(database.usersRecordset(), m_selectedUserId))
        refreshForm(true);
}

void UserAccounts::cancelChanges()
{
    setEditMode(false);
    m_mode = Mode::Browsing;
    updateSelId(0, 0);
}

void UserAccounts::checkAllFields(int icon)
{
    m_fields.setRedraw(false);
    for (int row = 1; row <= m_fields.rowCount(); ++row) {
        if (m_fields.cell(row, FieldLabelColumn).icon >= 0)
            m_fields.editCell(row, FieldLabelColumn).icon = icon;
    }
    m_fields.setRedraw(true);
}

void UserAccounts::toggleField(int row)
{
    if (!m_editing || row < 1 || row > m_fields.rowCount())
        return;
    const int icon = m_fields.cell(row, FieldLabelColumn).icon;
    m_fields.editCell(row, FieldLabelColumn).icon = icon == Ticked ? Unticked : Ticked;
}

QString UserAccounts::tickedFields() const
{
    QStringList ids;
    for (int row = 1; row <= m_fields.rowCount(); ++row) {
        if (m_fields.cell(row, FieldLabelColumn).icon == Ticked)
            ids << m_fields.cellText(row, IdColumn);
    }
    return ids.isEmpty() ? NoFields : ids.join(u',');
}

void UserAccounts::reportSaveFailure(const QString &reason)
{
    m_prompter.message(reason + u"\r\n\r\nChanges to the user have not been saved!"_s, CannotSave,
                       Prompter::Icon::Exclamation);
}

bool UserAccounts::saveUser()
{
    MainDatabase &database = m_database;
    RecordSet &records = database.usersRecordset();
    const ErrorReporter errors(m_prompter);
    const auto failedWith = [&](const DbError &failure) {
        // The account is not saved; whatever was half-written is thrown away.
        records.cancelUpdate();
        errors.reportError(failure.number, failure.description, u"Save User"_s);
        return false;
    };
    if (const std::optional<DbError> failure = records.requery())
        return failedWith(*failure);

    QString reason;
    if (m_entry.userName.trimmed().isEmpty()) {
        reason = u"You must specify the Username!"_s;
    } else if (m_entry.password.trimmed().isEmpty()) {
        reason = u"You must specify the Password!"_s;
    } else if (m_mode == Mode::Adding) {
        DbError failure;
        const std::optional<bool> exists =
            RecordOperations(database, m_prompter)
                .valueExists(u"Users"_s, u"Username"_s, m_entry.userName, &failure);
        if (!exists)
            return failedWith(failure);
        if (*exists)
            reason = u"That username already exists"_s;
    }
    if (!reason.isEmpty()) {
        reportSaveFailure(reason);
        return false;
    }

    if (m_mode == Mode::Adding) {
        if (const std::optional<DbError> failure = records.addNew())
            return failedWith(*failure);
    } else if (!RecordOperations(database, m_prompter).findRecordById(records, m_selectedUserId)) {
        // Someone deleted it meanwhile: there is nothing left to edit.
        setEditMode(false);
        m_mode = Mode::Browsing;
        refreshForm(true);
        reportSaveFailure(u"This user account doesn't exist. It may have been deleted!"_s);
        return false;
    }
    const QString created = QLocale::c().toString(m_clock.now(), u"d MMM yyyy h:mm AP"_s);
    const std::pair<QString, QVariant> values[] = {{u"UserName"_s, m_entry.userName},
                                                   {u"Password"_s, m_entry.password},
                                                   {u"Type"_s, m_entry.type},
                                                   {u"DateCreated"_s, created},
                                                   {u"Fields"_s, tickedFields()}};
    for (const auto &[field, value] : values) {
        if (const std::optional<DbError> failure = records.setValue(field, value))
            return failedWith(*failure);
    }
    if (const std::optional<DbError> failure = records.update())
        return failedWith(*failure);
    if (m_mode == Mode::Adding) {
        // Show the new account once the list is read again.
        m_selectedUserId = records.value(u"ID"_s).toLongLong();
    }
    refreshForm(true);
    return true;
}

bool UserAccounts::saveChanges()
{
    if (!saveUser())
        return false;
    setEditMode(false);
    m_mode = Mode::Browsing;
    updateSelId(0, 0);
    return true;
}

bool UserAccounts::mayClose()
{
    if (m_mode == Mode::Browsing)
        return true;
    const Prompter::Answer answer = m_prompter.message(
        u"Would you like to save changes to the user before closing?"_s, u"Save Changes"_s,
        Prompter::Icon::Question, Prompter::Buttons::YesNoCancel);
    switch (answer) {
    case Prompter::Answer::Yes:
        return saveUser();
    case Prompter::Answer::No:
        return true;
    default:
        return false;
    }
}
