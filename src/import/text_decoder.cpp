#include "import/text_decoder.h"

#include <array>
#include <cerrno>

#include <iconv.h>

namespace ryn {

namespace {

/// By the C library's own tables.
class IconvDecoder : public TextDecoder {
  public:
    explicit IconvDecoder(const char* name) : handle(iconv_open("UTF-8", name)) {}
    IconvDecoder(const IconvDecoder&) = delete;
    IconvDecoder& operator=(const IconvDecoder&) = delete;
    ~IconvDecoder() override {
        if (IsOpen())
            iconv_close(handle);
    }

    bool IsOpen() const {
        // NOLINTNEXTLINE(performance-no-int-to-ptr): how iconv_open tells its failure
        return handle != reinterpret_cast<iconv_t>(-1);
    }

    void Decode(std::string_view bytes, std::string* text) override {
        kept.append(bytes);
        char* input = kept.data();
        std::size_t left = kept.size();
        while (left > 0) {
            std::array<char, 4096> buffer{};
            char* output = buffer.data();
            std::size_t room = buffer.size();
            const std::size_t result = iconv(handle, &input, &left, &output, &room);
            const int fault = result == kFailed ? errno : 0;
            text->append(buffer.data(), buffer.size() - room);
            if (fault == EINVAL) // cut at the end
                break;
            if (fault == EILSEQ) {
                AppendUtf8(0xFFFD, text);
                ++input;
                --left;
            }
        }
        kept.erase(0, kept.size() - left);
    }

  private:
    static constexpr auto kFailed = static_cast<std::size_t>(-1);

    iconv_t handle;
    std::string kept;
};

} // namespace

void Utf16Decoder::Decode(std::string_view bytes, std::string* text) {
    for (const char c : bytes) {
        const auto byte = static_cast<unsigned char>(c);
        if (!oddByte) {
            oddByte = byte;
            continue;
        }
        const unsigned first = *oddByte;
        oddByte.reset();
        TakeUnit(order == TextEncoding::Utf16LittleEndian ? first | (unsigned{byte} << 8)
                                                          : (first << 8) | byte,
                 text);
    }
}

void Utf16Decoder::TakeUnit(unsigned unit, std::string* text) {
    const bool isLow = unit >= 0xDC00 && unit < 0xE000;
    if (highSurrogate != 0) {
        const unsigned high = highSurrogate;
        highSurrogate = 0;
        if (isLow) {
            AppendUtf8(0x10000 + ((high - 0xD800) << 10) + (unit - 0xDC00), text);
            return;
        }
        AppendUtf8(0xFFFD, text);
    }
    if (unit >= 0xD800 && unit < 0xDC00)
        highSurrogate = unit;
    else
        AppendUtf8(isLow ? 0xFFFD : unit, text);
}

Status MakeDecoder(TextEncoding encoding, std::unique_ptr<TextDecoder>* decoder) {
    decoder->reset();
    if (encoding == TextEncoding::Utf16LittleEndian || encoding == TextEncoding::Utf16BigEndian)
        *decoder = std::make_unique<Utf16Decoder>(encoding);
    if (encoding != TextEncoding::ShiftJis && encoding != TextEncoding::EucJp)
        return Status::Ok();
    auto opened =
        std::make_unique<IconvDecoder>(encoding == TextEncoding::ShiftJis ? "CP932" : "EUC-JP");
    if (!opened->IsOpen())
        return Status::SystemFault("this system cannot convert " + EncodingName(encoding) +
                                   "; save the table as UTF-8");
    *decoder = std::move(opened);
    return Status::Ok();
}

} // namespace ryn
