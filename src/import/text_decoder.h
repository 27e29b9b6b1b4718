#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "base/status.h"
#include "import/text_encoding.h"

namespace ryn {

/// Converts a text to UTF-8 in blocks. A character that a block cuts is kept for the next one.
class TextDecoder {
  public:
    virtual ~TextDecoder() = default;
    /// Appends the text of `bytes`. What is no character becomes U+FFFD.
    virtual void Decode(std::string_view bytes, std::string* text) = 0;
};

/// The decoder of an encoding whose bytes do not keep to ASCII's: UTF-16, and Shift_JIS, whose
/// characters may end with a bar. None for the others. A system fault where the machine lacks the
/// conversion.
Status MakeDecoder(TextEncoding encoding, std::unique_ptr<TextDecoder>* decoder);

class Utf16Decoder : public TextDecoder {
  public:
    explicit Utf16Decoder(TextEncoding encoding) : order(encoding) {}

    void Decode(std::string_view bytes, std::string* text) override;

  private:
    void TakeUnit(unsigned unit, std::string* text);

    TextEncoding order;
    std::optional<unsigned char> oddByte;
    unsigned highSurrogate = 0;
};

} // namespace ryn
