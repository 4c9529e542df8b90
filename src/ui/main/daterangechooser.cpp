// Veltrix — KPI dashboard for small businesses.
#include "daterangechooser.h"

#include "common/prompter.h"

#include <QComboBox>
#include <QFocusEvent>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QPushButton>
#include <QTimer>

using namespace Qt::StringLiterals;

DateRangeChooser::DateRangeChooser(const QLocale &locale, int currentYear, Prompter &prompter,
                                   QWidget *parent)
    : QWidget(parent)
    , m_currentYear(currentYear)
    , m_prompter(prompter)
{
    m_lstMonth1 = monthList(locale, u"lstMonth1"_s);
    m_lstYear1 = yearBox(u"lstYear1"_s);
    m_lstMonth2 = monthList(locale, u"lstMonth2"_s);
    m_lstYear2 = yearBox(u"lstYear2"_s);

    const auto stepButton = [&](const QString &text, const QString &tip, auto step) {
        auto *button = new QPushButton(text, this);
        button->setToolTip(tip);
        button->setFixedWidth(32);
        connect(button, &QPushButton::clicked, this, step);
        return button;
    };
    auto *row = new QHBoxLayout(this);
    // The chooser sits in the window's row of date controls as if it were part of it.
    row->setContentsMargins(0, 0, 0, 0);
    row->addWidget(new QLabel(u"From date"_s, this));
    row->addWidget(m_lstMonth1);
    row->addWidget(m_lstYear1);
    row->addWidget(new QLabel(u"To date"_s, this));
    row->addWidget(m_lstMonth2);
    row->addWidget(m_lstYear2);
    row->addWidget(stepButton(u"«"_s, u"Previous Year"_s, &DateRangeChooser::stepPreviousYear));
    row->addWidget(stepButton(u"‹"_s, u"Previous Month"_s, &DateRangeChooser::stepPreviousMonth));
    row->addWidget(stepButton(u"›"_s, u"Following Month"_s, &DateRangeChooser::stepFollowingMonth));
    row->addWidget(stepButton(u"»"_s, u"Following Year"_s, &DateRangeChooser::stepFollowingYear));
}

QComboBox *DateRangeChooser::monthList(const QLocale &locale, const QString &name)
{
    auto *list = new QComboBox(this);
    list->setObjectName(name);
    for (int month = 1; month <= 12; ++month)
        list->addItem(locale.standaloneMonthName(month));
    return list;
}

QComboBox *DateRangeChooser::yearBox(const QString &name)
{
    auto *box = new QComboBox(this);
    box->setObjectName(name);
    box->setEditable(true);
    // A typed year is a choice, not a new entry of the list.
    box->setInsertPolicy(QComboBox::NoInsert);
    for (int year = m_currentYear; year >= m_currentYear - 20; --year)
        box->addItem(QString::number(year));
    box->installEventFilter(this);
    connect(box->lineEdit(), &QLineEdit::textEdited, this,
            [this, box] { m_typedYears.insert(box); });
    return box;
}

RangeSelection::Selection DateRangeChooser::selection() const
{
    return {m_lstMonth1->currentIndex() + 1, m_lstYear1->currentText().toInt(),
            m_lstMonth2->currentIndex() + 1, m_lstYear2->currentText().toInt()};
}

void DateRangeChooser::showSelection(const RangeSelection::Selection &selection)
{
    m_lstMonth1->setCurrentIndex(selection.firstMonth - 1);
    m_lstYear1->setEditText(QString::number(selection.firstYear));
    m_lstMonth2->setCurrentIndex(selection.lastMonth - 1);
    m_lstYear2->setEditText(QString::number(selection.lastYear));
    m_typedYears.clear();
}

void DateRangeChooser::showRemembered(const RangeSelection::Remembered &remembered)
{
    m_lstMonth1->setCurrentIndex(remembered.firstMonth - 1);
    m_lstMonth2->setCurrentIndex(remembered.lastMonth - 1);
    m_lstYear1->setEditText(remembered.firstYear);
    m_lstYear2->setEditText(remembered.lastYear);
    m_typedYears.clear();
}

bool DateRangeChooser::checkYears()
{
    for (QComboBox *box : {m_lstYear1, m_lstYear2}) {
        if (isRefusable(box)) {
            refuseYear(box);
            return false;
        }
    }
    return true;
}

bool DateRangeChooser::isRefusable(const QComboBox *box) const
{
    return m_typedYears.contains(box) &&
           !RangeSelection::isValidYear(box->currentText(), m_currentYear);
}

void DateRangeChooser::refuseYear(QComboBox *box)
{
    m_refusedYears.insert(box, box->currentText());
    m_prompter.message(RangeSelection::invalidYearMessage(m_currentYear),
                       RangeSelection::InvalidYearTitle, Prompter::Icon::Exclamation);
    box->setFocus(Qt::OtherFocusReason);
    box->lineEdit()->selectAll();
}

void DateRangeChooser::step(
    const std::function<std::optional<RangeSelection::Selection>(const RangeSelection::Selection &)>
        &next)
{
    if (!checkYears())
        return;
    const std::optional<RangeSelection::Selection> stepped = next(selection());
    if (!stepped) {
        m_prompter.message(RangeSelection::LimitMessage, RangeSelection::LimitTitle,
                           Prompter::Icon::Exclamation);
        return;
    }
    showSelection(*stepped);
    Q_EMIT this->stepped();
}

void DateRangeChooser::stepPreviousMonth()
{
    step(RangeSelection::previousMonth);
}

void DateRangeChooser::stepFollowingMonth()
{
    step([this](const auto &selection) {
        return RangeSelection::followingMonth(selection, m_currentYear);
    });
}

void DateRangeChooser::stepPreviousYear()
{
    step(RangeSelection::previousYear);
}

void DateRangeChooser::stepFollowingYear()
{
    step([this](const auto &selection) {
        return RangeSelection::followingYear(selection, m_currentYear);
    });
}

bool DateRangeChooser::eventFilter(QObject *watched, QEvent *event)
{
    if (event->type() == QEvent::FocusOut && (watched == m_lstYear1 || watched == m_lstYear2)) {
        // Only the user moving on inside the window leaves the box: another application, a
        // menu or a message taking the focus does not, and every command checks the years.
        const Qt::FocusReason reason = static_cast<QFocusEvent *>(event)->reason();
        if (reason == Qt::TabFocusReason || reason == Qt::BacktabFocusReason ||
            reason == Qt::MouseFocusReason) {
            auto *box = static_cast<QComboBox *>(watched);
            // Looked at once the click or key has done its work, so that a command it ran and
            // refused the year for is not followed by the same message again.
            QTimer::singleShot(0, box, [this, box] {
                if (isRefusable(box) && m_refusedYears.value(box) != box->currentText())
                    refuseYear(box);
            });
        }
    }
    return QWidget::eventFilter(watched, event);
}
