// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QDate>
#include <QHash>
#include <QString>
#include <QStringList>

#include <array>

class NumberFormat;

// The KPI figures of up to five date ranges, one per period slot, addressed by Field ID.
// Slot 0 is the range chosen in the main window; slots 1 to 4 are the comparison's earlier
// periods. Every operation works on the current slot. Figures are kept as decimal text, in
// the order they were computed; the first entry of an ID wins.
class PeriodDataSet
{
public:
    static constexpr int SlotCount = 5;

    // How a figure is rounded when stored, and what an account figure's sign means.
    enum TypeCode {
        Money = 0,
        Ratio = 1,         // stored as a percentage
        AccountFigure = 2, // as the accounting package gives it; read back negated
        Count = 3,
        OneDecimal = 4,
        ComputedMoney = 5,
    };

    struct Slot
    {
        QStringList fieldIds;
        QStringList fieldValues;
        QStringList fieldAbs;
        QStringList fieldTypes;

        int size() const { return int(fieldIds.size()); }
        bool isEmpty() const { return fieldIds.isEmpty(); }

        // Position (from 1) of the first entry of the ID; 0 when there is none.
        int findFieldPos(qint64 id) const;

    private:
        friend class PeriodDataSet;
        struct Numbers
        {
            double value;
            double magnitude;
            bool accountFigure;
        };

        // Entries are only ever appended, so the first position of each ID is remembered as
        // the list grows; a formula reads hundreds of figures per load.
        mutable QHash<qint64, int> m_firstPosition;
        mutable int m_indexed = 0;
        mutable bool m_irregular = false; // an ID not written as a plain integer
        mutable QList<Numbers> m_numbers; // the texts read as numbers, entry by entry
    };

    struct Range
    {
        QDate start;
        QDate end;
    };

    explicit PeriodDataSet(const NumberFormat &numberFormat);

    quint8 currentSlot() const { return m_current; }
    void setCurrentSlot(quint8 slot);

    Slot &slot(int index) { return m_slots.at(index); }
    const Slot &slot(int index) const { return m_slots.at(index); }
    Slot &current() { return m_slots.at(m_current); }
    const Slot &current() const { return m_slots.at(m_current); }
    void clearCurrent() { current() = Slot(); }
    // A slot the loader is filling holds only part of a load: it is never kept as the cache.
    bool isFilling(int slot) const { return m_filling.at(slot); }
    void setFilling(int slot, bool filling) { m_filling.at(slot) = filling; }

    Range range(int slot) const { return m_ranges.at(slot); }
    void setRange(int slot, const Range &range) { m_ranges.at(slot) = range; }

    // Position (from 1) of the first entry whose ID equals id numerically; 0 when none does.
    static int findFieldPos(const QStringList &ids, qint64 id);
    double getFieldValue(qint64 id) const;
    double getFieldAbs(qint64 id) const;
    double sumFieldValues(qint64 first, qint64 last) const;

    // Appends a computed figure rounded by its type code; zero is kept as empty text.
    void storeFieldValue(qint64 id, double value, int typeCode);
    // Appends an account figure as the package gave it: unrounded, zero written as 0.
    void storeAccountFigure(qint64 id, double total, int fieldType);

    // The text a figure is stored as (storage) or, for the comparison's average column,
    // shown as, where the code is the Field's Type.
    QString formatFieldValue(double value, int typeCode, bool storage) const;

    // Rounds as storage does: half away from zero for codes 0, 1, 2 and 5, half to even for
    // 3 and 4; other codes give 0. Ratios come back as percentages.
    static double roundForStorage(double value, int typeCode);
    // The shortest decimal text that reads back as the same number, independent of region.
    static QString numberText(double value);

private:
    double readNumber(const QString &text) const;
    const Slot::Numbers &numbersAt(const Slot &slot, int pos) const;

    const NumberFormat &m_numberFormat;
    std::array<Slot, SlotCount> m_slots;
    std::array<Range, SlotCount> m_ranges;
    std::array<bool, SlotCount> m_filling{};
    quint8 m_current = 0;
};
