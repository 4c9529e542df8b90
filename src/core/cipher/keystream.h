// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QByteArray>

#include <array>

// The byte stream that stored passwords are enciphered with: three key-scheduled permutations
// of 463, 251 and 181 entries, each stepped by the byte the one before it produced, the first
// by the last ciphertext byte.
class KeyStream
{
public:
    // The key must not be empty; the second key may be.
    KeyStream(const QByteArray &key, const QByteArray &secondKey);

    quint8 nextKeyByte(quint8 feedback);

    // XOR with the stream, feeding each ciphertext byte back.
    QByteArray encipher(const QByteArray &plain);
    QByteArray decipher(const QByteArray &cipher);

private:
    template<std::size_t N> struct Permutation
    {
        std::array<quint16, N> table{};
        std::size_t i = 0;
        std::size_t j = 0;

        quint8 step(quint8 input);
    };

    Permutation<463> m_a;
    Permutation<251> m_b;
    Permutation<181> m_c;
};
