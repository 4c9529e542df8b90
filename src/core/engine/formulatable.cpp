// Veltrix — KPI dashboard for small businesses.
#include "formulatable.h"

using namespace Qt::StringLiterals;

namespace FormulaTable {

namespace {

// Step, Field, formula, storage code (0 money, 1 ratio kept as a percentage, 3 whole count,
// 4 one decimal, 5 money). Percentages that are reused (steps 25, 27, 67 to 72 and 75) are
// divided by 100 first, so that storing them as ratios gives back the same percentage.
struct Definition
{
    int number;
    int field;
    QString formula;
    int typeCode;
};

QList<Step> parseAll()
{
    const Definition definitions[] = {
        {1, 79, u"S[72..78] + V[118]"_s, 0},
        {2, 104, u"A[81] / V[79]"_s, 1},
        {3, 105, u"A[82] / V[79]"_s, 1},
        {4, 89, u"S[81..88] + V[99] + S[119..120]"_s, 5},
        {5, 90, u"V[79] + V[89]"_s, 0},
        {6, 92, u"V[90] / V[79]"_s, 1},
        {7, 106, u"A[89] / V[79]"_s, 1},
        {8, 107, u"A[101] / V[79]"_s, 1},
        {9, 108, u"A[102] / V[79]"_s, 1},
        {10, 103, u"V[101] + V[102]"_s, 5},
        {11, 109, u"A[103] / V[79]"_s, 1},
        {12, 110, u"V[79] + V[89] + V[103]"_s, 0},
        {13, 111, u"V[110] / V[79]"_s, 1},
        {14, 112, u"V[110] / W"_s, 0},
        {15, 15, u"V[13] + V[14]"_s, 0},
        {16, 16, u"V[15] / V[13]"_s, 1},
        {17, 18, u"V[15] + V[17]"_s, 0},
        {18, 19, u"V[18] / V[13]"_s, 1},
        {19, 23, u"V[21] + V[22]"_s, 0},
        {20, 24, u"A[23] / A[21]"_s, 1},
        {21, 27, u"V[23] + V[25] + V[26]"_s, 0},
        {22, 28, u"V[27] / V[21]"_s, 1},
        {23, 30, u"V[13] + V[21]"_s, 0},
        {24, 31, u"V[15] + V[23]"_s, 0},
        {25, 32, u"((A[16] + A[24]) / 100) / 2"_s, 1},
        {26, 33, u"V[17] + V[25] + V[26] + V[31]"_s, 0},
        {27, 34, u"((A[19] + A[28]) / 100) / 2"_s, 1},
        {28, 37, u"V[35] + V[36]"_s, 0},
        {29, 38, u"V[37] / V[35]"_s, 1},
        {30, 39, u"V[35] / J"_s, 0},
        {31, 40, u"V[36] / J"_s, 0},
        {32, 41, u"V[75] / S[72..75]"_s, 1},
        {33, 42, u"V[35] / V[79]"_s, 1},
        {34, 93, u"V[37] / J"_s, 0},
        {35, 46, u"A[45] / A[43]"_s, 1},
        {36, 47, u"A[45] / V[79]"_s, 1},
        {37, 50, u"A[49] / A[43]"_s, 1},
        {38, 51, u"A[49] / V[79]"_s, 1},
        {39, 53, u"V[45] + V[49]"_s, 0},
        {40, 54, u"A[53] / A[43]"_s, 1},
        {41, 55, u"A[53] / V[79]"_s, 1},
        {42, 115, u"A[117] / A[43]"_s, 1},
        {43, 116, u"A[117] / V[79]"_s, 1},
        {44, 96, u"W"_s, 3},
        {45, 97, u"J"_s, 3},
        {46, 94, u"J / W"_s, 3},
        {47, 124, u"A[79] / J"_s, 0},
        {48, 56, u"J / (D / 7)"_s, 3},
        {49, 57, u"V[30] / J"_s, 0},
        {50, 58, u"(V[14] + V[22]) / J"_s, 0},
        {51, 59, u"V[57] + V[58]"_s, 0},
        {52, 60, u"A[59] / A[57]"_s, 1},
        {53, 125, u"V[103] / V[97]"_s, 0},
        {54, 126, u"V[110] / V[97]"_s, 0},
        {55, 62, u"V[13] / H[1]"_s, 4},
        {56, 63, u"V[21] / H[2]"_s, 4},
        {57, 64, u"V[62] + V[63]"_s, 4},
        {58, 65, u"V[62] / J"_s, 4},
        {59, 66, u"V[63] / J"_s, 4},
        {60, 67, u"V[64] / J"_s, 4},
        {61, 127, u"(V[30] - V[31]) / V[64]"_s, 0},
        {62, 68, u"V[25] / V[63]"_s, 0},
        {63, 69, u"V[26] / V[63]"_s, 0},
        {64, 98, u"((A[25] + A[26]) / A[63]) * -1"_s, 0},
        {65, 70, u"V[17] / V[62]"_s, 0},
        {66, 113, u"V[117] / V[63]"_s, 0},
        {67, 1, u"V[16] / 100"_s, 1},
        {68, 2, u"V[24] / 100"_s, 1},
        {69, 3, u"V[19] / 100"_s, 1},
        {70, 4, u"V[28] / 100"_s, 1},
        {71, 5, u"V[38] / 100"_s, 1},
        {72, 6, u"V[41] / 100"_s, 1},
        {73, 7, u"J"_s, 3},
        {74, 8, u"A[79] / J"_s, 0},
        {75, 11, u"V[92] / 100"_s, 1},
    };
    QList<Step> steps;
    for (const Definition &definition : definitions) {
        QString problem;
        std::optional<Formula> formula = Formula::parse(definition.formula, &problem);
        Q_ASSERT_X(formula, "FormulaTable", qPrintable(problem));
        if (formula)
            steps.append({definition.number, definition.field, *formula, definition.typeCode});
    }
    return steps;
}

} // namespace

const QList<Step> &steps()
{
    static const QList<Step> table = parseAll();
    return table;
}

} // namespace FormulaTable
