// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "grid/gridmodel.h"

#include <QObject>

class MainDatabase;
class Prompter;
class Clock;

// The login accounts as the User Accounts dialog works on them: the list of accounts, the KPI
// lines with their ticks, the account being shown, added or edited, and every command of the
// dialog. Changes go straight to the Users table; the dialog is a view over this.
class UserAccounts : public QObject
{
    Q_OBJECT

public:
    enum class Mode { Browsing = 0, Adding = 1, Editing = 2 };
    enum Icon { NoIcon = -1, Unticked = 0, Ticked = 1 };

    struct Entry
    {
        QString userName;
        QString password;
        int type = 0; // 0 standard user, 1 administrator
    };

    static constexpr int MaxUserNameLength = 16;
    static constexpr int MaxPasswordLength = 8;
    static constexpr int UserNameColumn = 2;

    UserAccounts(MainDatabase &database, Prompter &prompter, const Clock &clock,
                 QObject *parent = nullptr);

    // Builds both lists and shows the first account.
    void load();

    GridModel &users() { return m_users; }
    GridModel &fields() { return m_fields; }
    Mode mode() const { return m_mode; }
    // Whether the entry boxes, the lines and the save buttons are open for input.
    bool editing() const { return m_editing; }
    qint64 selectedUserId() const { return m_selectedUserId; }
    const Entry &entry() const { return m_entry; }
    void setEntry(const Entry &entry) { m_entry = entry; }
    int sortColumn() const { return m_sortColumn; }
    bool sortAscending() const { return m_sortAscending; }

    void refreshForm(bool requery);
    // Shows the account of the row (0: the selected row); an ID below 1 is read from the row.
    // While adding or editing, the account being edited stays the one shown.
    void updateSelId(int row, qint64 id);
    void selectUser(int row);
    void headerClicked(int column);

    void add();
    void edit();
    void deleteSelected();
    bool saveUser();
    // Save Changes: saves and, when that worked, goes back to browsing.
    bool saveChanges();
    void cancelChanges();
    void checkAllFields(int icon);
    // A click on a line: ticked becomes unticked and anything else ticked.
    void toggleField(int row);
    // Asks about unsaved changes; false keeps the dialog open.
    bool mayClose();

    // "1,2,5", or "#" when no line is ticked.
    QString tickedFields() const;

    static inline const QString NoFields = QStringLiteral("#");

Q_SIGNALS:
    // The entry, the mode or the lists changed: the view shows them again.
    void changed();
    // Adding starts: the view puts the cursor into the user name.
    void startedAdding();

private:
    void fillFieldList();
    void setEditMode(bool editing);
    void reportSaveFailure(const QString &reason);

    MainDatabase &m_database;
    Prompter &m_prompter;
    const Clock &m_clock;
    GridModel m_users;
    GridModel m_fields;
    Entry m_entry;
    qint64 m_selectedUserId = 0;
    Mode m_mode = Mode::Browsing;
    bool m_editing = false;
    int m_sortColumn = UserNameColumn;
    bool m_sortAscending = true;
};
