// Veltrix — KPI dashboard for small businesses.
#pragma once

#include <QByteArray>

// The compressed container inside a stored password. "HE3" holds Huffman-coded bytes with
// their code table and a check byte; "HE0" holds bytes that would not get shorter, unchanged.
// Integers are little-endian and bit runs are packed least significant bit first.
class HuffmanCodec
{
public:
    enum class Status {
        Ok,
        ChecksumMismatch, // decoded, but the check byte disagrees: the bytes are suspect
        NotIdentified,    // neither "HE0" nor "HE3"
        Corrupt,          // the table or the data cannot be decoded
    };

    struct Decoded
    {
        Status status = Status::Ok;
        QByteArray bytes;
    };

    static QByteArray encode(const QByteArray &bytes);
    // The codes are rebuilt from the stored table alone, so any prefix code decodes.
    static Decoded decode(const QByteArray &container);
};
