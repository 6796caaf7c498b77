#include "core/tcvn3.h"

#include <array>
#include <cstdint>

namespace kavu {
namespace {

// Unicode of the TCVN3 bytes 0xA0 to 0xFE; 0 where the byte is no VN3 letter
// (the combining marks and the capitals with tone marks of the other
// variants). The capitals with tone marks have no code of their own: a
// capitals font draws the lowercase code as the capital.
constexpr std::array<char32_t, 0xFF - 0xA0> kHigh = {
    0x00A0, 0x0102, 0x00C2, 0x00CA, 0x00D4, 0x01A0, 0x01AF, 0x0110,  // A0
    0x0103, 0x00E2, 0x00EA, 0x00F4, 0x01A1, 0x01B0, 0x0111, 0x0000,  // A8
    0x0000, 0x0000, 0x0000, 0x0000, 0x0000, 0x00E0, 0x1EA3, 0x00E3,  // B0
    0x00E1, 0x1EA1, 0x0000, 0x1EB1, 0x1EB3, 0x1EB5, 0x1EAF, 0x0000,  // B8
    0x0000, 0x0000, 0x0000, 0x0000, 0x0000, 0x0000, 0x1EB7, 0x1EA7,  // C0
    0x1EA9, 0x1EAB, 0x1EA5, 0x1EAD, 0x00E8, 0x0000, 0x1EBB, 0x1EBD,  // C8
    0x00E9, 0x1EB9, 0x1EC1, 0x1EC3, 0x1EC5, 0x1EBF, 0x1EC7, 0x00EC,  // D0
    0x1EC9, 0x0000, 0x0000, 0x0000, 0x0129, 0x00ED, 0x1ECB, 0x00F2,  // D8
    0x0000, 0x1ECF, 0x00F5, 0x00F3, 0x1ECD, 0x1ED3, 0x1ED5, 0x1ED7,  // E0
    0x1ED1, 0x1ED9, 0x1EDD, 0x1EDF, 0x1EE1, 0x1EDB, 0x1EE3, 0x00F9,  // E8
    0x0000, 0x1EE7, 0x0169, 0x00FA, 0x1EE5, 0x1EEB, 0x1EED, 0x1EEF,  // F0
    0x1EE9, 0x1EF1, 0x1EF3, 0x1EF7, 0x1EF9, 0x00FD, 0x1EF5,          // F8
};

// The twelve vowels that take tone marks: their codes without a tone (lower
// and capital) and with grave, hook, tilde, acute and dot below. Used to join
// a vowel and a following combining tone mark.
struct Vowel {
  unsigned char lower;
  unsigned char upper;
  std::array<unsigned char, 5> toned;
};
constexpr std::array<Vowel, 12> kVowels = {{
    {'a', 'A', {0xB5, 0xB6, 0xB7, 0xB8, 0xB9}},
    {0xA8, 0xA1, {0xBB, 0xBC, 0xBD, 0xBE, 0xC6}},
    {0xA9, 0xA2, {0xC7, 0xC8, 0xC9, 0xCA, 0xCB}},
    {'e', 'E', {0xCC, 0xCE, 0xCF, 0xD0, 0xD1}},
    {0xAA, 0xA3, {0xD2, 0xD3, 0xD4, 0xD5, 0xD6}},
    {'i', 'I', {0xD7, 0xD8, 0xDC, 0xDD, 0xDE}},
    {'o', 'O', {0xDF, 0xE1, 0xE2, 0xE3, 0xE4}},
    {0xAB, 0xA4, {0xE5, 0xE6, 0xE7, 0xE8, 0xE9}},
    {0xAC, 0xA5, {0xEA, 0xEB, 0xEC, 0xED, 0xEE}},
    {'u', 'U', {0xEF, 0xF1, 0xF2, 0xF3, 0xF4}},
    {0xAD, 0xA6, {0xF5, 0xF6, 0xF7, 0xF8, 0xF9}},
    {'y', 'Y', {0xFA, 0xFB, 0xFC, 0xFD, 0xFE}},
}};

// Raw bytes outside TCVN3 travel through the display as these private-use
// characters.
constexpr char32_t kRawBase = 0xF700;

int ToneOf(char32_t combining) {
  switch (combining) {
    case 0x0300:
      return 0;  // grave
    case 0x0309:
      return 1;  // hook above
    case 0x0303:
      return 2;  // tilde
    case 0x0301:
      return 3;  // acute
    case 0x0323:
      return 4;  // dot below
    default:
      return -1;
  }
}

// Letters made of a plain letter and a combining circumflex, breve or horn.
struct Modified {
  unsigned char base;
  char32_t mark;
  unsigned char result;
};
constexpr std::array<Modified, 12> kModified = {{
    {'a', 0x0302, 0xA9},
    {'A', 0x0302, 0xA2},
    {'e', 0x0302, 0xAA},
    {'E', 0x0302, 0xA3},
    {'o', 0x0302, 0xAB},
    {'O', 0x0302, 0xA4},
    {'a', 0x0306, 0xA8},
    {'A', 0x0306, 0xA1},
    {'o', 0x031B, 0xAC},
    {'O', 0x031B, 0xA5},
    {'u', 0x031B, 0xAD},
    {'U', 0x031B, 0xA6},
}};

int VowelOf(unsigned char byte) {
  for (std::size_t i = 0; i < kVowels.size(); ++i) {
    if (kVowels[i].lower == byte || kVowels[i].upper == byte) return static_cast<int>(i);
  }
  return -1;
}

// The code of one character, or -1.
int Encode(char32_t c) {
  if (c < 0x80) return static_cast<int>(c);
  if (c >= kRawBase + 0x80 && c <= kRawBase + 0xFF) return static_cast<int>(c - kRawBase);
  for (std::size_t i = 0; i < kHigh.size(); ++i) {
    if (kHigh[i] == c) return static_cast<int>(0xA0 + i);
  }
  // A capital with a tone mark takes its lowercase letter's code.
  char32_t lower = 0;
  if (c >= 0xC0 && c <= 0xDE && c != 0xD7) {
    lower = c + 0x20;
  } else if (((c >= 0x100 && c <= 0x17F) || (c >= 0x1EA0 && c <= 0x1EF9)) && c % 2 == 0) {
    lower = c + 1;
  }
  if (lower != 0) {
    for (std::size_t i = 0; i < kHigh.size(); ++i) {
      if (kHigh[i] == lower) return static_cast<int>(0xA0 + i);
    }
  }
  return -1;
}

// Decodes one UTF-8 sequence at text[i]; advances i. Returns -1 and advances by
// one byte on a malformed sequence.
long NextCodePoint(std::string_view text, std::size_t& i) {
  const auto byte = [&](std::size_t k) { return static_cast<unsigned char>(text[k]); };
  const unsigned char b0 = byte(i);
  if (b0 < 0x80) {
    ++i;
    return b0;
  }
  std::size_t length = 0;
  char32_t c = 0;
  char32_t minimum = 0;
  if (b0 >= 0xC2 && b0 <= 0xDF) {
    length = 2, c = b0 & 0x1F, minimum = 0x80;
  } else if (b0 >= 0xE0 && b0 <= 0xEF) {
    length = 3, c = b0 & 0x0F, minimum = 0x800;
  } else if (b0 >= 0xF0 && b0 <= 0xF4) {
    length = 4, c = b0 & 0x07, minimum = 0x10000;
  } else {
    ++i;
    return -1;
  }
  if (i + length > text.size()) {
    ++i;
    return -1;
  }
  for (std::size_t k = 1; k < length; ++k) {
    const unsigned char b = byte(i + k);
    if ((b & 0xC0) != 0x80) {
      ++i;
      return -1;
    }
    c = (c << 6) | (b & 0x3F);
  }
  if (c < minimum || c > 0x10FFFF || (c >= 0xD800 && c <= 0xDFFF)) {
    ++i;
    return -1;
  }
  i += length;
  return static_cast<long>(c);
}

void AppendUtf8(std::string& out, char32_t c) {
  if (c < 0x80) {
    out.push_back(static_cast<char>(c));
  } else if (c < 0x800) {
    out.push_back(static_cast<char>(0xC0 | (c >> 6)));
    out.push_back(static_cast<char>(0x80 | (c & 0x3F)));
  } else {
    out.push_back(static_cast<char>(0xE0 | (c >> 12)));
    out.push_back(static_cast<char>(0x80 | ((c >> 6) & 0x3F)));
    out.push_back(static_cast<char>(0x80 | (c & 0x3F)));
  }
}

}  // namespace

std::string Utf8ToTcvn3(std::string_view utf8) {
  std::string out;
  out.reserve(utf8.size());
  // The vowel just written, which a following combining mark may join (the
  // decomposed forms of NFD text: "o" U+0302 U+0309 is "ổ").
  int last_vowel = -1;
  std::size_t i = 0;
  while (i < utf8.size()) {
    const long c = NextCodePoint(utf8, i);
    if (c < 0) {
      out.push_back('?');
      last_vowel = -1;
      continue;
    }
    if (last_vowel >= 0) {
      bool joined = false;
      for (const Modified& m : kModified) {
        if (m.mark == static_cast<char32_t>(c) &&
            static_cast<unsigned char>(out.back()) == m.base) {
          out.back() = static_cast<char>(m.result);
          last_vowel = VowelOf(m.result);
          joined = true;
          break;
        }
      }
      if (joined) continue;
    }
    const int tone = ToneOf(static_cast<char32_t>(c));
    if (tone >= 0 && last_vowel >= 0) {
      out.back() = static_cast<char>(kVowels[static_cast<std::size_t>(last_vowel)].toned[tone]);
      last_vowel = -1;
      continue;
    }
    const int code = Encode(static_cast<char32_t>(c));
    const bool raw = c >= static_cast<long>(kRawBase);
    out.push_back(code < 0 ? '?' : static_cast<char>(code));
    last_vowel = code < 0 || raw ? -1 : VowelOf(static_cast<unsigned char>(code));
  }
  return out;
}

std::string Tcvn3ToUtf8(std::string_view tcvn3) {
  std::string out;
  out.reserve(tcvn3.size() * 2);
  for (const char ch : tcvn3) {
    const auto b = static_cast<unsigned char>(ch);
    char32_t c = b;
    if (b >= 0x80) {
      c = b >= 0xA0 && b < 0xFF ? kHigh[b - 0xA0] : 0;
      if (c == 0) c = kRawBase + b;
    }
    AppendUtf8(out, c);
  }
  return out;
}

}  // namespace kavu
