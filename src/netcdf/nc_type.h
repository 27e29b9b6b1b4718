#pragma once

namespace ryn {

/// Types of variables and attributes, with the C library's numbers.
enum class NcType : int {
    Byte = 1,
    Char = 2,
    Short = 3,
    Int = 4,
    Float = 5,
    Double = 6,
    UByte = 7,
    UShort = 8,
    UInt = 9,
    Int64 = 10,
    UInt64 = 11,
    String = 12, ///< and larger numbers: types that a file defines, which nothing here reads
};

inline bool IsNumeric(NcType type) {
    return type < NcType::String && type != NcType::Char;
}

/// Bytes of a value; 0 for what is neither a number nor a character.
inline int BytesOf(NcType type) {
    constexpr int kBytes[] = {0, 1, 1, 2, 4, 4, 8, 1, 2, 4, 8, 8};
    return type < NcType::String ? kBytes[static_cast<int>(type)] : 0;
}

} // namespace ryn
