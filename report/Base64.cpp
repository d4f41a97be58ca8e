// Base64 encoding and decoding with the standard alphabet, into buffers the
// caller owns and frees with free().
#include <cstdlib>

#include "braigrion/TWriterUtil.h"

namespace braigrion {

namespace {

const char kAlphabet[] = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";

// The value of an alphabet character, -1 for any other byte.
int Sextet(unsigned char c) {
    if (c >= 'A' && c <= 'Z') return c - 'A';
    if (c >= 'a' && c <= 'z') return c - 'a' + 26;
    if (c >= '0' && c <= '9') return c - '0' + 52;
    if (c == '+') return 62;
    if (c == '/') return 63;
    return -1;
}

}  // namespace

int base64_encode(const char* input, int length, char** output, int* outputLength) {
    if (length < 0) length = 0;
    const int size = ((length / 3) + (length % 3 ? 1 : 0)) * 4 + 1;
    char* out = static_cast<char*>(std::calloc(static_cast<size_t>(size), 1));
    if (out == nullptr) return 0;
    const unsigned char* in = reinterpret_cast<const unsigned char*>(input);
    int o = 0;
    for (int i = 0; i < length; i += 3) {
        const int left = length - i;
        unsigned int group = static_cast<unsigned int>(in[i]) << 16;
        if (left > 1) group |= static_cast<unsigned int>(in[i + 1]) << 8;
        if (left > 2) group |= static_cast<unsigned int>(in[i + 2]);
        out[o++] = kAlphabet[(group >> 18) & 0x3F];
        out[o++] = kAlphabet[(group >> 12) & 0x3F];
        out[o++] = left > 1 ? kAlphabet[(group >> 6) & 0x3F] : '=';
        out[o++] = left > 2 ? kAlphabet[group & 0x3F] : '=';
    }
    *output = out;
    *outputLength = size;
    return 1;
}

int base64_decode(const char* input, int length, char** output, int& outputLength) {
    if (length < 0) length = 0;
    int padding = 0;
    for (int i = length - 1; i >= 0 && i >= length - 3; --i) {
        if (input[i] == '=') ++padding;
    }
    const int margin = padding <= 1 ? 4 : (padding == 2 ? 3 : 2);
    const int size = length / 4 * 3 + margin;
    char* out = static_cast<char*>(std::calloc(static_cast<size_t>(size), 1));
    if (out == nullptr) return 0;

    // Four characters give three bytes; a short last group gives fewer.
    // Padding ends the data; bytes outside the alphabet (line breaks) are
    // stepped over.
    int o = 0;
    unsigned int group = 0;
    int inGroup = 0;
    for (int i = 0; i < length && input[i] != '='; ++i) {
        int value = Sextet(static_cast<unsigned char>(input[i]));
        if (value < 0) continue;
        group = (group << 6) | static_cast<unsigned int>(value);
        if (++inGroup == 4) {
            out[o++] = static_cast<char>((group >> 16) & 0xFF);
            out[o++] = static_cast<char>((group >> 8) & 0xFF);
            out[o++] = static_cast<char>(group & 0xFF);
            group = 0;
            inGroup = 0;
        }
    }
    if (inGroup == 2) {
        out[o++] = static_cast<char>((group >> 4) & 0xFF);
    } else if (inGroup == 3) {
        out[o++] = static_cast<char>((group >> 10) & 0xFF);
        out[o++] = static_cast<char>((group >> 2) & 0xFF);
    }
    out[o] = '\0';
    *output = out;
    outputLength = o;
    return 1;
}

}  // namespace braigrion
