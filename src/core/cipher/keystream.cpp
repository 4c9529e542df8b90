// Veltrix — KPI dashboard for small businesses.
#include "keystream.h"

#include <numeric>
#include <utility>

namespace {

// Mixes the permutation with the given key material; j runs on from one table to the next.
template<std::size_t N, typename KeyByte>
void schedule(std::array<quint16, N> &table, std::size_t &j, KeyByte keyByte)
{
    std::iota(table.begin(), table.end(), quint16(0));
    for (std::size_t i = 0; i < N; ++i) {
        j = (table[i] + j + keyByte(i)) % N;
        std::swap(table[i], table[j]);
    }
}

template<std::size_t N, std::size_t M>
std::array<quint8, M> fold(const std::array<quint16, N> &table)
{
    std::array<quint8, M> folded{};
    for (std::size_t i = 0; i < N; ++i)
        folded[i % M] ^= static_cast<quint8>(table[i] % 256);
    return folded;
}

} // namespace

template<std::size_t N> quint8 KeyStream::Permutation<N>::step(quint8 input)
{
    i = (i + 1) % N;
    j = (table[i] + j + input) % N;
    std::swap(table[i], table[j]);
    return static_cast<quint8>(table[(table[j] + table[i]) % N] % 256);
}

KeyStream::KeyStream(const QByteArray &key, const QByteArray &secondKey)
{
    Q_ASSERT(!key.isEmpty());
    const auto n = static_cast<std::size_t>(key.size());
    std::size_t j = 0;

    schedule(m_a.table, j, [&](std::size_t i) { return static_cast<quint8>(key[i % n]); });
    const auto x = fold<463, 17>(m_a.table);

    schedule(m_b.table, j, [&](std::size_t i) { return x[i % 17]; });
    auto y = fold<251, 23>(m_b.table);

    if (!secondKey.isEmpty()) {
        const auto m = static_cast<std::size_t>(secondKey.size());
        for (std::size_t i = 0; i < y.size(); ++i)
            y[i] ^= static_cast<quint8>(secondKey[i % m]);
    }
    schedule(m_c.table, j, [&](std::size_t i) { return y[i % 23]; });
}

quint8 KeyStream::nextKeyByte(quint8 feedback)
{
    const quint8 a = m_a.step(feedback);
    const quint8 b = m_b.step(a);
    const quint8 c = m_c.step(b);
    return static_cast<quint8>((a + b + c) % 256);
}

QByteArray KeyStream::encipher(const QByteArray &plain)
{
    QByteArray cipher(plain.size(), Qt::Uninitialized);
    quint8 feedback = 0;
    for (qsizetype i = 0; i < plain.size(); ++i) {
        const auto c = static_cast<quint8>(static_cast<quint8>(plain[i]) ^ nextKeyByte(feedback));
        cipher[i] = static_cast<char>(c);
        feedback = c;
    }
    return cipher;
}

QByteArray KeyStream::decipher(const QByteArray &cipher)
{
    QByteArray plain(cipher.size(), Qt::Uninitialized);
    quint8 feedback = 0;
    for (qsizetype i = 0; i < cipher.size(); ++i) {
        const auto c = static_cast<quint8>(cipher[i]);
        plain[i] = static_cast<char>(c ^ nextKeyByte(feedback));
        feedback = c;
    }
    return plain;
}
