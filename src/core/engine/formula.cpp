// Veltrix — KPI dashboard for small businesses.
#include "formula.h"

#include <QList>

#include <cmath>

using namespace Qt::StringLiterals;

struct Formula::Node
{
    enum class Kind {
        Number,
        Value,
        Magnitude,
        Sum,
        Rate,
        DaySpan,
        WorkingDays,
        Jobs,
        Add,
        Subtract,
        Multiply,
        Divide,
        Negate
    };
    Kind kind = Kind::Number;
    double number = 0.0;
    int first = 0;
    int last = 0;
    std::shared_ptr<const Node> left;
    std::shared_ptr<const Node> right;
};

namespace {

using Node = Formula::Node;
using NodePtr = std::shared_ptr<const Node>;

// A recursive-descent reader of the formula grammar:
//   sum     := product (("+" | "-") product)*
//   product := unary (("*" | "/") unary)*
//   unary   := "-" unary | primary
//   primary := number | "(" sum ")" | V[n] | A[n] | H[n] | S[a..b] | D | W | J
class Parser
{
public:
    explicit Parser(const QString &text)
        : m_text(text)
    {}

    NodePtr parse()
    {
        NodePtr root = sum();
        skipSpaces();
        if (root && m_position != m_text.size())
            fail(u"unexpected text"_s);
        return m_problem.isEmpty() ? root : nullptr;
    }
    QString problem() const { return m_problem; }

private:
    void skipSpaces()
    {
        while (m_position < m_text.size() && m_text.at(m_position).isSpace())
            ++m_position;
    }
    bool take(QChar c)
    {
        skipSpaces();
        if (m_position < m_text.size() && m_text.at(m_position) == c) {
            ++m_position;
            return true;
        }
        return false;
    }
    NodePtr fail(const QString &what)
    {
        if (m_problem.isEmpty())
            m_problem = u"%1 at position %2 of \"%3\""_s.arg(what).arg(m_position + 1).arg(m_text);
        return nullptr;
    }
    static NodePtr binary(Node::Kind kind, NodePtr left, NodePtr right)
    {
        auto node = std::make_shared<Node>();
        node->kind = kind;
        node->left = std::move(left);
        node->right = std::move(right);
        return node;
    }

    NodePtr sum()
    {
        NodePtr left = product();
        while (left) {
            if (take(u'+'))
                left = binary(Node::Kind::Add, left, product());
            else if (take(u'-'))
                left = binary(Node::Kind::Subtract, left, product());
            else
                break;
            if (!left->right)
                return nullptr;
        }
        return left;
    }

    NodePtr product()
    {
        NodePtr left = unary();
        while (left) {
            if (take(u'*'))
                left = binary(Node::Kind::Multiply, left, unary());
            else if (take(u'/'))
                left = binary(Node::Kind::Divide, left, unary());
            else
                break;
            if (!left->right)
                return nullptr;
        }
        return left;
    }

    NodePtr unary()
    {
        if (take(u'-')) {
            NodePtr operand = unary();
            return operand ? binary(Node::Kind::Negate, operand, nullptr) : nullptr;
        }
        return primary();
    }

    std::optional<int> integer()
    {
        skipSpaces();
        const qsizetype start = m_position;
        while (m_position < m_text.size() && m_text.at(m_position).isDigit())
            ++m_position;
        if (start == m_position)
            return std::nullopt;
        return m_text.mid(start, m_position - start).toInt();
    }

    NodePtr primary()
    {
        skipSpaces();
        if (m_position >= m_text.size())
            return fail(u"missing operand"_s);
        if (take(u'(')) {
            NodePtr inner = sum();
            if (inner && !take(u')'))
                return fail(u"missing \")\""_s);
            return inner;
        }
        const QChar c = m_text.at(m_position);
        if (c.isDigit()) {
            const qsizetype start = m_position;
            while (m_position < m_text.size() &&
                   (m_text.at(m_position).isDigit() || m_text.at(m_position) == u'.'))
                ++m_position;
            bool ok = false;
            auto node = std::make_shared<Node>();
            node->number = m_text.mid(start, m_position - start).toDouble(&ok);
            return ok ? node : fail(u"bad number"_s);
        }
        ++m_position;
        auto node = std::make_shared<Node>();
        switch (c.unicode()) {
        case u'D':
            node->kind = Node::Kind::DaySpan;
            return node;
        case u'W':
            node->kind = Node::Kind::WorkingDays;
            return node;
        case u'J':
            node->kind = Node::Kind::Jobs;
            return node;
        case u'V':
            node->kind = Node::Kind::Value;
            break;
        case u'A':
            node->kind = Node::Kind::Magnitude;
            break;
        case u'H':
            node->kind = Node::Kind::Rate;
            break;
        case u'S':
            node->kind = Node::Kind::Sum;
            break;
        default:
            return fail(u"unknown term"_s);
        }
        if (!take(u'['))
            return fail(u"missing \"[\""_s);
        const std::optional<int> first = integer();
        if (!first)
            return fail(u"missing number"_s);
        node->first = node->last = *first;
        if (node->kind == Node::Kind::Sum) {
            if (!take(u'.') || !take(u'.'))
                return fail(u"missing \"..\""_s);
            const std::optional<int> last = integer();
            if (!last)
                return fail(u"missing number"_s);
            node->last = *last;
        }
        if (!take(u']'))
            return fail(u"missing \"]\""_s);
        return node;
    }

    const QString &m_text;
    qsizetype m_position = 0;
    QString m_problem;
};

std::optional<double> finite(double value)
{
    return std::isfinite(value) ? std::optional<double>(value) : std::nullopt;
}

std::optional<double> evaluateNode(const Node &node, const Formula::Inputs &in)
{
    using Kind = Node::Kind;
    switch (node.kind) {
    case Kind::Number:
        return node.number;
    case Kind::Value:
        return in.value(node.first);
    case Kind::Magnitude:
        return in.magnitude(node.first);
    case Kind::Sum:
        return in.sum(node.first, node.last);
    case Kind::Rate:
        return in.hourlyRate(node.first);
    case Kind::DaySpan:
        return double(in.daySpan);
    case Kind::WorkingDays:
        return double(in.workingDays);
    case Kind::Jobs:
        return double(in.jobs);
    case Kind::Negate: {
        const auto operand = evaluateNode(*node.left, in);
        return operand ? std::optional<double>(-*operand) : std::nullopt;
    }
    default:
        break;
    }
    const auto left = evaluateNode(*node.left, in);
    if (!left)
        return std::nullopt;
    const auto right = evaluateNode(*node.right, in);
    if (!right)
        return std::nullopt;
    switch (node.kind) {
    case Kind::Add:
        return finite(*left + *right);
    case Kind::Subtract:
        return finite(*left - *right);
    case Kind::Multiply:
        return finite(*left * *right);
    case Kind::Divide:
        // 0 / 0 fails as well: a ratio of nothing to nothing is not 0 %.
        if (*right == 0.0)
            return std::nullopt;
        return finite(*left / *right);
    default:
        return std::nullopt;
    }
}

} // namespace

Formula::Formula(QString text, std::shared_ptr<const Node> root)
    : m_text(std::move(text))
    , m_root(std::move(root))
{}

Formula::Formula(const Formula &other) = default;
Formula &Formula::operator=(const Formula &other) = default;
Formula::Formula(Formula &&) noexcept = default;
Formula &Formula::operator=(Formula &&) noexcept = default;
Formula::~Formula() = default;

std::optional<Formula> Formula::parse(const QString &text, QString *problem)
{
    Parser parser(text);
    NodePtr root = parser.parse();
    if (!root) {
        if (problem)
            *problem = parser.problem();
        return std::nullopt;
    }
    return Formula(text, std::move(root));
}

std::optional<double> Formula::evaluate(const Inputs &inputs) const
{
    return evaluateNode(*m_root, inputs);
}
