// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QString>

#include <functional>
#include <memory>
#include <optional>

// One KPI formula over the figures of a period, written as the design tables write it:
//   V[n]      the signed figure of Field n        A[n]  its magnitude
//   S[a..b]   the sum of V[a] to V[b]             H[n]  the hourly rate of department n
//   D         days from start to end              W     working days (Monday to Friday)
//   J         jobs done in the range
// with numbers, + - * /, unary minus and brackets. Evaluation fails on a division by zero or
// an overflow, so that the Field it computes can be left out instead of holding nonsense.
class Formula
{
public:
    struct Inputs
    {
        std::function<double(int)> value;      // V[n]
        std::function<double(int)> magnitude;  // A[n]
        std::function<double(int, int)> sum;   // S[a..b]
        std::function<double(int)> hourlyRate; // H[n]
        int daySpan = 0;                       // D
        int workingDays = 0;                   // W
        int jobs = 0;                          // J
    };

    // Nothing when the text is not a formula of this form; the description says where.
    static std::optional<Formula> parse(const QString &text, QString *problem = nullptr);

    std::optional<double> evaluate(const Inputs &inputs) const;
    QString text() const { return m_text; }

    Formula(const Formula &other);
    Formula &operator=(const Formula &other);
    Formula(Formula &&) noexcept;
    Formula &operator=(Formula &&) noexcept;
    ~Formula();

    struct Node;

private:
    Formula(QString text, std::shared_ptr<const Node> root);

    QString m_text;
    std::shared_ptr<const Node> m_root;
};
