#include "fieldbook/DxfWriter.h"

#include "core/Angles.h"
#include "core/LargeBlocks.h"
#include "core/TextEncoding.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstring>

namespace pyr::dxf {

namespace {

using Buffer = std::pmr::string;

inline constexpr std::string_view kEnd = "\r\n";
// A text of the drawing is drawn some 0.8 of its height wide per character: what the extents count for
// it, no font being at hand.
inline constexpr double kCharacterWidth = 0.8;
// Degrees of a DXF angle for one grad.
inline constexpr double kDegreesPerGrad = 0.9;

constexpr std::array<double, 10> kPowersOfTen = {1e0, 1e1, 1e2, 1e3, 1e4, 1e5, 1e6, 1e7, 1e8, 1e9};
// Below 2^52 a double holds every integer and every half-integer exactly.
inline constexpr double kTwoTo52 = 4503599627370496.0;

// The lines of the group codes 0 to 99, each with its line end, made once.
const std::array<std::string, 100> kCodeLines = [] {
    std::array<std::string, 100> lines;
    for (std::size_t code = 0; code < lines.size(); ++code)
        lines[code] = std::to_string(code) + std::string(kEnd);
    return lines;
}();

void Code(Buffer& out, int code) {
    if (code >= 0 && code < static_cast<int>(kCodeLines.size())) {
        out += kCodeLines[static_cast<std::size_t>(code)];
        return;
    }
    char buffer[8];
    const auto result = std::to_chars(buffer, buffer + sizeof buffer, code);
    out.append(buffer, result.ptr);
    out += kEnd;
}

void Group(Buffer& out, int code, std::string_view value) {
    Code(out, code);
    out += value;
    out += kEnd;
}

void Group(Buffer& out, int code, int value) {
    Code(out, code);
    char buffer[16];
    const auto result = std::to_chars(buffer, buffer + sizeof buffer, value);
    out.append(buffer, result.ptr);
    out += kEnd;
}

// Drops the trailing zeros of a fraction and its point: "12.500" -> "12.5", "3.000" -> "3"; "-0" -> "0".
void TrimFraction(Buffer& out, std::size_t start) {
    if (out.find('.', start) != std::string::npos) {
        while (out.back() == '0')
            out.pop_back();
        if (out.back() == '.') out.pop_back();
    }
    if (out.size() == start + 2 && out[start] == '-' && out[start + 1] == '0') out.erase(start, 1);
}

// Writes the two digits of a number below 100 just before `p`; returns where they start.
char* TwoDigits(char* p, std::uint64_t number) {
    static constexpr char kPairs[] =
        "00010203040506070809101112131415161718192021222324252627282930313233343536373839"
        "4041424344454647484950515253545556575859606162636465666768697071727374757677787980"
        "81828384858687888990919293949596979899";
    p -= 2;
    std::memcpy(p, kPairs + 2 * number, 2);
    return p;
}

// The value rounded to `decimals` places, trailing zeros dropped, as the decimal text of the double
// gives it. The scaled value rounded to an integer is the text's digits whenever it is below 2^52 and
// not exactly a half (RoundToDecimals in core/Numbers.cpp says why); a half or a huge value goes
// through to_chars.
void AppendRounded(Buffer& out, double value, int decimals) {
    const double scaled = std::fabs(value * kPowersOfTen[static_cast<std::size_t>(decimals)]);
    const double whole = (scaled + kTwoTo52) - kTwoTo52;
    if (scaled >= kTwoTo52 || std::fabs(scaled - whole) == 0.5) {
        const std::size_t start = out.size();
        char buffer[400];
        const auto result =
            std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed, decimals);
        out.append(buffer, result.ptr);
        TrimFraction(out, start);
        return;
    }
    const auto scale = static_cast<std::uint64_t>(kPowersOfTen[static_cast<std::size_t>(decimals)]);
    const auto digits = static_cast<std::uint64_t>(whole);
    std::uint64_t integer = digits / scale;
    std::uint64_t fraction = digits % scale;
    char buffer[32];
    char* end = buffer + sizeof buffer;
    char* p = end;
    if (fraction != 0) {
        int places = decimals;
        while (fraction % 10 == 0) {
            fraction /= 10;
            --places;
        }
        for (; places >= 2; places -= 2, fraction /= 100)
            p = TwoDigits(p, fraction % 100);
        if (places == 1) *--p = static_cast<char>('0' + fraction);
        *--p = '.';
    }
    for (; integer >= 100; integer /= 100)
        p = TwoDigits(p, integer % 100);
    if (integer >= 10)
        p = TwoDigits(p, integer);
    else
        *--p = static_cast<char>('0' + integer);
    if (value < 0.0 && whole != 0.0) *--p = '-';
    out.append(p, end);
}

// The next character of a UTF-8 text, or the byte itself (marked invalid) when it starts no valid
// sequence.
char32_t NextCharacter(std::string_view text, std::size_t& i, bool& valid) {
    const auto byte = [&](std::size_t k) { return static_cast<unsigned char>(text[k]); };
    const unsigned char lead = byte(i);
    valid = true;
    if (lead < 0x80) {
        ++i;
        return lead;
    }
    int length = lead >= 0xF0 && lead <= 0xF4 ? 4 : lead >= 0xE0 ? 3 : lead >= 0xC2 && lead < 0xE0 ? 2 : 0;
    if (length == 0 || i + static_cast<std::size_t>(length) > text.size()) {
        valid = false;
        ++i;
        return lead;
    }
    char32_t cp = lead & (0x7F >> length);
    for (int k = 1; k < length; ++k) {
        const unsigned char next = byte(i + static_cast<std::size_t>(k));
        if ((next & 0xC0) != 0x80) {
            valid = false;
            ++i;
            return lead;
        }
        cp = (cp << 6) | (next & 0x3F);
    }
    const bool overlong = (length == 3 && cp < 0x800) || (length == 4 && cp < 0x10000);
    if (overlong || cp > 0x10FFFF || (cp >= 0xD800 && cp <= 0xDFFF)) {
        valid = false;
        ++i;
        return lead;
    }
    i += static_cast<std::size_t>(length);
    return cp;
}

// The Windows-1252 bytes 0x80 to 0x9F, as Unicode characters (0 where the code page has none).
constexpr std::array<char32_t, 32> kWindows1252High = {
    0x20AC, 0,      0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0,      0x017D, 0,      0,      0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0,      0x017E, 0x0178};

// The Windows-1252 byte of a character, 0 when the code page does not hold it.
unsigned char Windows1252Byte(char32_t cp) {
    if (cp < 0x80 || (cp >= 0xA0 && cp <= 0xFF)) return static_cast<unsigned char>(cp);
    for (std::size_t k = 0; k < kWindows1252High.size(); ++k)
        if (kWindows1252High[k] == cp) return static_cast<unsigned char>(0x80 + k);
    return 0;
}

void AppendText(Buffer& out, std::string_view text) {
    const bool plain = std::all_of(text.begin(), text.end(), [](char c) {
        const auto byte = static_cast<unsigned char>(c);
        return byte >= 0x20 && byte < 0x7F;
    });
    if (plain) {
        out += text;
        return;
    }
    for (std::size_t i = 0; i < text.size();) {
        bool valid = true;
        const char32_t cp = NextCharacter(text, i, valid);
        if (!valid) {
            // Not UTF-8: a byte from a Windows machine, taken as the code page's own.
            const bool control = cp < 0xA0 && kWindows1252High[cp - 0x80] == 0;
            out += control ? ' ' : static_cast<char>(cp);
        } else if (cp < 0x20 || cp == 0x7F || (cp >= 0x80 && cp < 0xA0)) {
            out += ' ';
        } else if (const unsigned char byte = Windows1252Byte(cp); byte != 0) {
            out += static_cast<char>(byte);
        } else if (cp <= 0xFFFF) {
            char buffer[8];
            std::snprintf(buffer, sizeof buffer, "\\U+%04X", static_cast<unsigned>(cp));
            out += buffer;
        } else {
            out += '?';
        }
    }
}

// The plain capital letters of a Latin letter with its accent, "" when it is no letter.
std::string_view PlainLetters(char32_t cp) {
    // U+00C0 to U+00FF, capitals and small letters alike.
    static constexpr std::array<std::string_view, 64> kLatin1 = {
        "A", "A", "A", "A", "A", "A", "AE", "C", "E", "E", "E", "E", "I", "I", "I",  "I",
        "D", "N", "O", "O", "O", "O", "O",  "",  "O", "U", "U", "U", "U", "Y", "TH", "SS",
        "A", "A", "A", "A", "A", "A", "AE", "C", "E", "E", "E", "E", "I", "I", "I",  "I",
        "D", "N", "O", "O", "O", "O", "O",  "",  "O", "U", "U", "U", "U", "Y", "TH", "Y"};
    if (cp >= 0xC0 && cp <= 0xFF) return kLatin1[cp - 0xC0];
    switch (cp) {
    case 0x0152:
    case 0x0153:
        return "OE";
    case 0x0160:
    case 0x0161:
        return "S";
    case 0x017D:
    case 0x017E:
        return "Z";
    case 0x0178:
        return "Y";
    default:
        return "";
    }
}

} // namespace

std::string ValidName(std::string_view text) {
    std::string name;
    for (std::size_t i = 0; i < text.size() && name.size() < kMaxNameLength;) {
        bool valid = true;
        const char32_t cp = NextCharacter(text, i, valid);
        if (!valid) {
            name += '_';
        } else if (cp < 0x80) {
            const char c = static_cast<char>(cp);
            if (c >= 'a' && c <= 'z')
                name += static_cast<char>(c - 'a' + 'A');
            else if ((c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '$' || c == '-' || c == '_')
                name += c;
            else
                name += '_';
        } else if (const std::string_view plain = PlainLetters(cp); !plain.empty()) {
            name += plain;
        } else {
            name += '_';
        }
    }
    if (name.size() > kMaxNameLength) name.resize(kMaxNameLength);
    return name.empty() ? std::string("0") : name;
}

void DxfWriter::Box::Add(const Point3& p) {
    if (!any) {
        min = max = p;
        any = true;
        return;
    }
    min.x = std::min(min.x, p.x);
    min.y = std::min(min.y, p.y);
    min.z = std::min(min.z, p.z);
    max.x = std::max(max.x, p.x);
    max.y = std::max(max.y, p.y);
    max.z = std::max(max.z, p.z);
}

void DxfWriter::Box::Add(const Box& other) {
    if (!other.any) return;
    Add(other.min);
    Add(other.max);
}

namespace {

bool Finite(const Point3& p) {
    return std::isfinite(p.x) && std::isfinite(p.y) && std::isfinite(p.z);
}

} // namespace

DxfWriter::DxfWriter(int decimals) : m_decimals(std::clamp(decimals, 0, 9)), m_entities(LargeBlocks()) {
    Layer("0");
}

int DxfWriter::Layer(std::string_view name, int colour) {
    std::string valid = ValidName(name);
    if (const auto found = m_layerNumbers.find(valid); found != m_layerNumbers.end()) return found->second;
    const int number = static_cast<int>(m_layers.size());
    m_layers.push_back({valid, std::clamp(colour, 1, 255)});
    m_layerNumbers.emplace(std::move(valid), number);
    return number;
}

void DxfWriter::SetPointDisplay(int mode, double size) {
    m_pointMode = mode;
    m_pointSize = std::isfinite(size) ? size : 0.0;
}

void DxfWriter::Start(Buffer& out, std::string_view kind, int layer) const {
    out += "0\r\n";
    out += kind;
    out += "\r\n8\r\n";
    const std::size_t index =
        layer >= 0 && layer < static_cast<int>(m_layers.size()) ? static_cast<std::size_t>(layer) : 0;
    out += m_layers[index].name;
    out += kEnd;
}

void DxfWriter::Number(Buffer& out, int code, double value) const {
    Code(out, code);
    AppendRounded(out, value, m_decimals);
    out += kEnd;
}

void DxfWriter::Coordinates(Buffer& out, int code, const Point3& p) const {
    Number(out, code, p.x);
    Number(out, code + 10, p.y);
    Number(out, code + 20, p.z);
}

bool DxfWriter::Point(int layer, Point3 at) {
    if (!Finite(at)) return false;
    if (Measuring()) {
        m_extents.Add(at);
        return true;
    }
    Buffer& out = Body();
    Start(out, "POINT", layer);
    Coordinates(out, 10, at);
    Extents().Add(at);
    return true;
}

bool DxfWriter::Text(int layer, Point3 at, std::string_view text, const TextStyle& style) {
    if (!Finite(at) || !std::isfinite(style.height) || !std::isfinite(style.rotationGrads)) return false;
    if (text.empty()) return true;
    AddTextExtents(at, text, style);
    if (Measuring()) return true;
    Buffer& out = Body();
    Start(out, "TEXT", layer);
    const bool aligned = style.horizontal != HAlign::Left || style.vertical != VAlign::Baseline;
    Coordinates(out, 10, at);
    if (style.height != m_height) {
        m_height = style.height;
        Buffer text;
        AppendRounded(text, m_height, m_decimals);
        m_heightText = std::move(text);
    }
    Code(out, 40);
    out += m_heightText;
    out += kEnd;
    Code(out, 1);
    AppendText(out, text);
    out += kEnd;
    if (style.rotationGrads != 0.0) Number(out, 50, style.rotationGrads * kDegreesPerGrad);
    if (aligned) {
        if (style.horizontal != HAlign::Left) Group(out, 72, static_cast<int>(style.horizontal));
        Coordinates(out, 11, at);
        if (style.vertical != VAlign::Baseline) Group(out, 73, static_cast<int>(style.vertical));
    }

    return true;
}

void DxfWriter::AddTextExtents(const Point3& at, std::string_view text, const TextStyle& style) {
    // The extents take the text's box, estimated, turned about its insertion point.
    const double width = kCharacterWidth * style.height * static_cast<double>(Utf8Length(text));
    const double left = style.horizontal == HAlign::Left     ? 0.0
                        : style.horizontal == HAlign::Center ? -width / 2
                                                             : -width;
    const double bottom = style.vertical == VAlign::Middle ? -style.height / 2
                          : style.vertical == VAlign::Top  ? -style.height
                                                           : 0.0;
    if (style.rotationGrads != m_rotationGrads) {
        m_rotationGrads = style.rotationGrads;
        SinCosGrads(m_rotationGrads, m_sin, m_cos);
    }
    Box& extents = Extents();
    for (const double u : {left, left + width})
        for (const double v : {bottom, bottom + style.height})
            extents.Add(Point3{at.x + u * m_cos - v * m_sin, at.y + u * m_sin + v * m_cos, at.z});
}

bool DxfWriter::Line(int layer, Point3 from, Point3 to) {
    if (!Finite(from) || !Finite(to)) return false;
    Extents().Add(from);
    Extents().Add(to);
    if (Measuring()) return true;
    Buffer& out = Body();
    Start(out, "LINE", layer);
    Coordinates(out, 10, from);
    Coordinates(out, 11, to);
    return true;
}

bool DxfWriter::Polyline(int layer, std::span<const Point3> vertices, bool closed, bool is3D) {
    if (!std::all_of(vertices.begin(), vertices.end(), Finite)) return false;
    if (vertices.size() < 2) return true;
    Box& extents = Extents();
    const double elevation = vertices.front().z;
    if (Measuring()) {
        for (const Point3& vertex : vertices)
            extents.Add(Point3{vertex.x, vertex.y, is3D ? vertex.z : elevation});
        return true;
    }
    Buffer& out = Body();
    Start(out, "POLYLINE", layer);
    Group(out, 66, 1);
    Coordinates(out, 10, {0.0, 0.0, is3D ? 0.0 : elevation});
    Group(out, 70, (closed ? 1 : 0) | (is3D ? 8 : 0));
    for (const Point3& vertex : vertices) {
        const Point3 at{vertex.x, vertex.y, is3D ? vertex.z : elevation};
        Start(out, "VERTEX", layer);
        Coordinates(out, 10, at);
        if (is3D) Group(out, 70, 32);
        extents.Add(at);
    }
    Start(out, "SEQEND", layer);
    return true;
}

bool DxfWriter::BeginBlock(std::string_view name, Point3 base) {
    if (m_inBlock || m_sink || !Finite(base)) return false;
    std::string valid = ValidName(name);
    if (std::any_of(m_blocks.begin(), m_blocks.end(), [&](const Block& b) { return b.name == valid; }))
        return false;
    m_blocks.push_back({std::move(valid), base, {}, {}});
    m_inBlock = true;
    return true;
}

void DxfWriter::EndBlock() {
    m_inBlock = false;
}

bool DxfWriter::Insert(int layer, std::string_view block, Point3 at, double scale, double rotationGrads) {
    if (m_inBlock || !Finite(at) || !std::isfinite(scale) || !std::isfinite(rotationGrads)) return false;
    const std::string valid = ValidName(block);
    const auto found =
        std::find_if(m_blocks.begin(), m_blocks.end(), [&](const Block& b) { return b.name == valid; });
    if (found == m_blocks.end()) return false;
    if (!m_measuring) {
        Buffer& out = m_entities;
        Start(out, "INSERT", layer);
        Group(out, 2, valid);
        Coordinates(out, 10, at);
        if (scale != 1.0) {
            Number(out, 41, scale);
            Number(out, 42, scale);
            Number(out, 43, scale);
        }
        if (rotationGrads != 0.0) Number(out, 50, rotationGrads * kDegreesPerGrad);
    }

    // The block's box, moved from its base point to the insertion point, scaled and turned.
    if (!found->extents.any) {
        m_extents.Add(at);
        return true;
    }
    double s = 0.0;
    double c = 1.0;
    SinCosGrads(rotationGrads, s, c);
    const Box& box = found->extents;
    const Point3& base = found->base;
    for (const double x : {box.min.x, box.max.x})
        for (const double y : {box.min.y, box.max.y})
            for (const double z : {box.min.z, box.max.z}) {
                const double u = (x - base.x) * scale;
                const double v = (y - base.y) * scale;
                m_extents.Add(
                    Point3{at.x + u * c - v * s, at.y + u * s + v * c, at.z + (z - base.z) * scale});
            }
    return true;
}

void DxfWriter::AppendHeader(Buffer& out) const {
    const Box& box = m_extents;
    const Point3 min = box.any ? box.min : Point3{};
    const Point3 max = box.any ? box.max : Point3{};
    Group(out, 0, "SECTION");
    Group(out, 2, "HEADER");
    Group(out, 9, "$ACADVER");
    Group(out, 1, "AC1009");
    Group(out, 9, "$DWGCODEPAGE");
    Group(out, 3, "ANSI_1252");
    Group(out, 9, "$INSBASE");
    Coordinates(out, 10, {});
    Group(out, 9, "$EXTMIN");
    Coordinates(out, 10, min);
    Group(out, 9, "$EXTMAX");
    Coordinates(out, 10, max);
    Group(out, 9, "$LIMMIN");
    Number(out, 10, min.x);
    Number(out, 20, min.y);
    Group(out, 9, "$LIMMAX");
    Number(out, 10, max.x);
    Number(out, 20, max.y);
    Group(out, 9, "$CLAYER");
    Group(out, 8, "0");
    Group(out, 9, "$TEXTSTYLE");
    Group(out, 7, "STANDARD");
    Group(out, 9, "$PDMODE");
    Group(out, 70, m_pointMode);
    Group(out, 9, "$PDSIZE");
    Number(out, 40, m_pointSize);
    Group(out, 0, "ENDSEC");
}

// The active viewport, showing the extents: the drawing opens on everything drawn.
void DxfWriter::AppendViewport(Buffer& out) const {
    const Box& box = m_extents;
    const double width = box.any ? box.max.x - box.min.x : 0.0;
    const double height = box.any ? box.max.y - box.min.y : 0.0;
    const double centreX = box.any ? (box.min.x + box.max.x) / 2 : 0.0;
    const double centreY = box.any ? (box.min.y + box.max.y) / 2 : 0.0;
    // A window of 4:3 that holds the extents with a margin.
    constexpr double kAspect = 4.0 / 3.0;
    const double viewHeight = std::max({height, width / kAspect, 1.0}) * 1.1;
    Group(out, 0, "TABLE");
    Group(out, 2, "VPORT");
    Group(out, 70, 1);
    Group(out, 0, "VPORT");
    Group(out, 2, "*ACTIVE");
    Group(out, 70, 0);
    Number(out, 10, 0.0);
    Number(out, 20, 0.0);
    Number(out, 11, 1.0);
    Number(out, 21, 1.0);
    Number(out, 12, centreX);
    Number(out, 22, centreY);
    Number(out, 13, 0.0);
    Number(out, 23, 0.0);
    Number(out, 14, 1.0);
    Number(out, 24, 1.0);
    Number(out, 15, 0.0);
    Number(out, 25, 0.0);
    Coordinates(out, 16, {0.0, 0.0, 1.0});
    Coordinates(out, 17, {});
    Number(out, 40, viewHeight);
    Number(out, 41, kAspect);
    Number(out, 42, 50.0);
    Number(out, 43, 0.0);
    Number(out, 44, 0.0);
    Number(out, 50, 0.0);
    Number(out, 51, 0.0);
    Group(out, 71, 0);
    Group(out, 72, 100);
    Group(out, 73, 1);
    Group(out, 74, 3);
    Group(out, 75, 0);
    Group(out, 76, 0);
    Group(out, 77, 0);
    Group(out, 78, 0);
    Group(out, 0, "ENDTAB");
}

void DxfWriter::AppendTables(Buffer& out) const {
    Group(out, 0, "SECTION");
    Group(out, 2, "TABLES");
    AppendViewport(out);

    Group(out, 0, "TABLE");
    Group(out, 2, "LTYPE");
    Group(out, 70, 1);
    Group(out, 0, "LTYPE");
    Group(out, 2, "CONTINUOUS");
    Group(out, 70, 0);
    Group(out, 3, "Solid line");
    Group(out, 72, 65);
    Group(out, 73, 0);
    Number(out, 40, 0.0);
    Group(out, 0, "ENDTAB");

    Group(out, 0, "TABLE");
    Group(out, 2, "LAYER");
    Group(out, 70, static_cast<int>(m_layers.size()));
    for (const LayerEntry& layer : m_layers) {
        Group(out, 0, "LAYER");
        Group(out, 2, layer.name);
        Group(out, 70, 0);
        Group(out, 62, layer.colour);
        Group(out, 6, "CONTINUOUS");
    }
    Group(out, 0, "ENDTAB");

    Group(out, 0, "TABLE");
    Group(out, 2, "STYLE");
    Group(out, 70, 1);
    Group(out, 0, "STYLE");
    Group(out, 2, "STANDARD");
    Group(out, 70, 0);
    Number(out, 40, 0.0);
    Number(out, 41, 1.0);
    Number(out, 50, 0.0);
    Group(out, 71, 0);
    Number(out, 42, 1.0);
    Group(out, 3, "txt");
    Group(out, 4, "");
    Group(out, 0, "ENDTAB");
    Group(out, 0, "ENDSEC");
}

void DxfWriter::AppendBlocks(Buffer& out) const {
    Group(out, 0, "SECTION");
    Group(out, 2, "BLOCKS");
    for (const Block& block : m_blocks) {
        Group(out, 0, "BLOCK");
        Group(out, 8, "0");
        Group(out, 2, block.name);
        Group(out, 70, 0);
        Coordinates(out, 10, block.base);
        Group(out, 3, block.name);
        out += block.body;
        Group(out, 0, "ENDBLK");
        Group(out, 8, "0");
    }
    Group(out, 0, "ENDSEC");
}

void DxfWriter::Measure() {
    m_measuring = true;
}

void DxfWriter::Stream(std::function<void(std::string_view)> sink) {
    EndBlock();
    Buffer head;
    AppendHead(head);
    sink(head);
    m_sink = std::move(sink);
    m_measuring = false;
    m_entities.clear();
    m_entities.reserve(kStreamChunk + (kStreamChunk >> 4));
}

void DxfWriter::Flush() {
    if (m_sink && m_entities.size() >= kStreamChunk) {
        m_sink(m_entities);
        m_entities.clear();
    }
}

void DxfWriter::AppendHead(Buffer& head) const {
    std::size_t blocks = 0;
    for (const Block& block : m_blocks)
        blocks += block.body.size() + 128;
    head.reserve(blocks + 2048 + 64 * m_layers.size());
    AppendHeader(head);
    AppendTables(head);
    AppendBlocks(head);
    Group(head, 0, "SECTION");
    Group(head, 2, "ENTITIES");
}

std::string_view DxfWriter::Finish() {
    EndBlock();
    if (!m_sink) {
        Buffer head;
        AppendHead(head);
        m_entities.insert(0, head);
    }
    Group(m_entities, 0, "ENDSEC");
    Group(m_entities, 0, "EOF");
    if (!m_sink) return m_entities;
    m_sink(m_entities);
    m_entities.clear();
    return {};
}

} // namespace pyr::dxf
