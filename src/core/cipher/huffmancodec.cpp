// Veltrix — KPI dashboard for small businesses.
#include "huffmancodec.h"

#include <QtEndian>

#include <array>
#include <memory>
#include <queue>
#include <vector>

namespace {

constexpr char StoredTag[] = "HE0\r";
constexpr char CodedTag[] = "HE3\r";
constexpr qsizetype TagSize = 4;
constexpr qsizetype FixedHeaderSize = TagSize + 1 + 4 + 2;

using Code = std::vector<bool>;

class BitWriter
{
public:
    void append(const Code &code)
    {
        for (const bool bit : code) {
            if (m_used == 0)
                m_bytes.append('\0');
            if (bit)
                m_bytes.back() = static_cast<char>(m_bytes.back() | (1 << m_used));
            m_used = (m_used + 1) % 8;
        }
    }
    QByteArray bytes() const { return m_bytes; }

private:
    QByteArray m_bytes;
    int m_used = 0;
};

class BitReader
{
public:
    BitReader(const char *data, qsizetype size)
        : m_data(data)
        , m_bitCount(size * 8)
    {}
    bool atEnd() const { return m_position >= m_bitCount; }
    qsizetype remaining() const { return m_bitCount - m_position; }
    bool next()
    {
        const bool bit = (m_data[m_position / 8] >> (m_position % 8)) & 1;
        ++m_position;
        return bit;
    }

private:
    const char *m_data;
    qsizetype m_bitCount;
    qsizetype m_position = 0;
};

// Builds a code for every byte value that occurs; a node's first child takes bit 0.
std::array<Code, 256> buildCodes(const std::array<quint64, 256> &frequencies)
{
    struct Node
    {
        quint64 weight;
        int symbol; // -1 for an inner node
        int children[2];
    };
    std::vector<Node> nodes;
    using Entry = std::pair<quint64, int>; // weight, node index
    std::priority_queue<Entry, std::vector<Entry>, std::greater<>> lightest;
    for (int value = 0; value < 256; ++value) {
        if (frequencies[value] > 0) {
            nodes.push_back({frequencies[value], value, {-1, -1}});
            lightest.emplace(frequencies[value], int(nodes.size()) - 1);
        }
    }
    while (lightest.size() > 1) {
        const Entry first = lightest.top();
        lightest.pop();
        const Entry second = lightest.top();
        lightest.pop();
        nodes.push_back({first.first + second.first, -1, {first.second, second.second}});
        lightest.emplace(nodes.back().weight, int(nodes.size()) - 1);
    }

    std::array<Code, 256> codes;
    if (nodes.empty())
        return codes;
    std::vector<std::pair<int, Code>> pending{{int(nodes.size()) - 1, Code{}}};
    while (!pending.empty()) {
        auto [index, code] = std::move(pending.back());
        pending.pop_back();
        const Node &node = nodes[index];
        if (node.symbol >= 0) {
            codes[node.symbol] = code;
            continue;
        }
        for (int bit = 0; bit < 2; ++bit) {
            Code child = code;
            child.push_back(bit == 1);
            pending.emplace_back(node.children[bit], std::move(child));
        }
    }
    return codes;
}

QByteArray storedContainer(const QByteArray &bytes)
{
    return QByteArray(StoredTag, TagSize) + bytes;
}

// A binary tree rebuilt from stored codes; refuses codes that are not a prefix code.
class DecodingTree
{
public:
    DecodingTree()
        : m_nodes(1)
    {}

    bool insert(const Code &code, quint8 symbol)
    {
        if (code.empty())
            return false;
        int index = 0;
        for (const bool bit : code) {
            if (m_nodes[index].symbol >= 0)
                return false;
            if (m_nodes[index].children[bit] < 0) {
                m_nodes[index].children[bit] = int(m_nodes.size());
                m_nodes.emplace_back(); // may move the nodes: index again afterwards
            }
            index = m_nodes[index].children[bit];
        }
        Node &leaf = m_nodes[index];
        if (leaf.symbol >= 0 || leaf.children[0] >= 0 || leaf.children[1] >= 0)
            return false;
        leaf.symbol = symbol;
        return true;
    }

    // The next symbol, or -1 when the bits run out or lead nowhere.
    int decodeSymbol(BitReader &bits) const
    {
        int index = 0;
        while (m_nodes[index].symbol < 0) {
            if (bits.atEnd())
                return -1;
            index = m_nodes[index].children[bits.next()];
            if (index < 0)
                return -1;
        }
        return m_nodes[index].symbol;
    }

private:
    struct Node
    {
        int symbol = -1;
        int children[2] = {-1, -1};
    };
    std::vector<Node> m_nodes;
};

} // namespace

QByteArray HuffmanCodec::encode(const QByteArray &bytes)
{
    if (bytes.isEmpty())
        return storedContainer({});

    std::array<quint64, 256> frequencies{};
    for (const char byte : bytes)
        ++frequencies[static_cast<quint8>(byte)];
    const std::array<Code, 256> codes = buildCodes(frequencies);

    quint64 dataBits = 0;
    quint64 tableBits = 0;
    quint16 codedValues = 0;
    for (int value = 0; value < 256; ++value) {
        dataBits += frequencies[value] * codes[value].size();
        if (frequencies[value] > 0) {
            tableBits += codes[value].size();
            ++codedValues;
        }
    }
    const quint64 dataBytes = (dataBits + 7) / 8;
    if (dataBytes == 0 || dataBytes > quint64(bytes.size()))
        return storedContainer(bytes);

    quint8 check = 0;
    for (const char byte : bytes)
        check ^= static_cast<quint8>(byte);

    QByteArray container(CodedTag, TagSize);
    container.append(static_cast<char>(check));
    char number[4];
    qToLittleEndian<quint32>(quint32(bytes.size()), number);
    container.append(number, 4);
    qToLittleEndian<quint16>(codedValues, number);
    container.append(number, 2);

    BitWriter codeTable;
    for (int value = 0; value < 256; ++value) {
        if (frequencies[value] == 0)
            continue;
        container.append(static_cast<char>(value));
        container.append(static_cast<char>(codes[value].size()));
        codeTable.append(codes[value]);
    }
    Q_ASSERT(quint64(codeTable.bytes().size()) == (tableBits + 7) / 8);
    container.append(codeTable.bytes());

    BitWriter data;
    for (const char byte : bytes)
        data.append(codes[static_cast<quint8>(byte)]);
    container.append(data.bytes());
    return container;
}

HuffmanCodec::Decoded HuffmanCodec::decode(const QByteArray &container)
{
    if (container.startsWith(QByteArrayView(StoredTag, TagSize)))
        return {Status::Ok, container.sliced(TagSize)};
    if (!container.startsWith(QByteArrayView(CodedTag, TagSize)))
        return {Status::NotIdentified, {}};
    if (container.size() < FixedHeaderSize)
        return {Status::Corrupt, {}};

    const char *raw = container.constData();
    const auto check = static_cast<quint8>(raw[TagSize]);
    const quint32 length = qFromLittleEndian<quint32>(raw + TagSize + 1);
    const quint16 codedValues = qFromLittleEndian<quint16>(raw + TagSize + 5);
    if (codedValues > 256 || container.size() < FixedHeaderSize + 2 * qsizetype(codedValues))
        return {Status::Corrupt, {}};

    std::vector<std::pair<quint8, int>> table; // value, code length
    qsizetype position = FixedHeaderSize;
    qsizetype tableBits = 0;
    for (int k = 0; k < codedValues; ++k) {
        const auto value = static_cast<quint8>(raw[position]);
        const auto codeLength = static_cast<quint8>(raw[position + 1]);
        table.emplace_back(value, codeLength);
        tableBits += codeLength;
        position += 2;
    }
    const qsizetype tableBytes = (tableBits + 7) / 8;
    if (container.size() - position < tableBytes)
        return {Status::Corrupt, {}};

    DecodingTree tree;
    BitReader codeBits(raw + position, tableBytes);
    for (const auto &[value, codeLength] : table) {
        Code code(codeLength);
        for (int bit = 0; bit < codeLength; ++bit)
            code[bit] = codeBits.next();
        if (!tree.insert(code, value))
            return {Status::Corrupt, {}};
    }
    position += tableBytes;

    // Every symbol takes at least one bit, which bounds what a damaged length can ask for.
    BitReader dataBits(raw + position, container.size() - position);
    if (qsizetype(length) > dataBits.remaining())
        return {Status::Corrupt, {}};
    QByteArray bytes;
    bytes.reserve(length);
    quint8 actualCheck = 0;
    for (quint32 n = 0; n < length; ++n) {
        const int symbol = tree.decodeSymbol(dataBits);
        if (symbol < 0)
            return {Status::Corrupt, {}};
        bytes.append(static_cast<char>(symbol));
        actualCheck ^= static_cast<quint8>(symbol);
    }
    return {actualCheck == check ? Status::Ok : Status::ChecksumMismatch, bytes};
}
