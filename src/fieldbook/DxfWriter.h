#pragma once

#include <cstddef>
#include <functional>
#include <memory_resource>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

// A drawing written as a DXF file of release 12 (AC1009), the exchange drawing that every CAD program
// of a surveyor's office opens. The writer knows layers, points, texts, lines, polylines, blocks and
// their insertions; that is all the exports of a survey draw.
//
// The file is text with CRLF line ends; its numbers always have a '.' as decimal point, whatever the
// user's locale. Coordinates are in metres, X east, Y north, Z up. The header gives the extents of
// everything drawn, and the header and the tables come before the entities: entities are gathered in
// memory and the whole file is assembled by Finish(). A drawing too big to stand whole in memory is drawn
// twice instead: once measured (Measure: the extents and the layers found, nothing written), then
// streamed (Stream: the header and the tables handed out at once, then the entities as they are drawn).
//
// Texts are written in Windows-1252, the code page that the header announces ($DWGCODEPAGE ANSI_1252);
// a character outside it goes as \U+XXXX, the escape that CAD programs read back, and control
// characters (a tab, a line feed) as blanks, a TEXT being one line.
namespace pyr::dxf {

struct Point3 {
    double x = 0.0;
    double y = 0.0;
    double z = 0.0;
};

// The colours of the drawing's palette (ACI) that the exports use: 7 is white on a dark background and
// black on a light one.
inline constexpr int kRed = 1;
inline constexpr int kYellow = 2;
inline constexpr int kGreen = 3;
inline constexpr int kCyan = 4;
inline constexpr int kBlue = 5;
inline constexpr int kMagenta = 6;
inline constexpr int kWhite = 7;

// The longest layer or block name that a release-12 drawing holds.
inline constexpr std::size_t kMaxNameLength = 31;

// A valid layer (or block) name for any text, such as a point's code: letters in capitals, accents
// dropped ("é" gives "E", "œ" "OE"), digits, '$', '-' and '_' kept, every other character (a blank, a
// dot, a slash ...) replaced by '_', and the result cut to 31 characters. The rule is fixed, so that
// the same code always gives the same name: two texts that differ only by what the rule changes ("mur
// bas" and "MUR.BAS") give the same name, and what is drawn under them shares that layer. An empty text
// gives "0", the layer that every drawing has.
std::string ValidName(std::string_view text);

// Where a text stands with respect to its insertion point.
enum class HAlign { Left, Center, Right };
enum class VAlign { Baseline, Bottom, Middle, Top };

struct TextStyle {
    double height = 1.0;        // metres
    double rotationGrads = 0.0; // the baseline's direction, counterclockwise from the X axis (east)
    HAlign horizontal = HAlign::Left;
    VAlign vertical = VAlign::Baseline;
};

class DxfWriter {
public:
    // Coordinates are written rounded to `decimals` places (0 to 9), their trailing zeros dropped:
    // 6 keeps a micrometre, far below what a survey measures.
    explicit DxfWriter(int decimals = 6);

    // ---- Layers. A layer is named once and then referred to by its number. Layer "0" is number 0.

    // The number of the layer of that name (made valid by ValidName), added with its colour (1 to 255)
    // the first time; a layer already added keeps its first colour.
    int Layer(std::string_view name, int colour = kWhite);
    int LayerCount() const { return static_cast<int>(m_layers.size()); }
    const std::string& LayerName(int layer) const { return m_layers[static_cast<std::size_t>(layer)].name; }

    // How the program showing the drawing draws a POINT: the $PDMODE of the header (0 a dot, 2 a cross,
    // 3 an X, 32 to 100 the same within a circle or a square) and its size $PDSIZE (positive: metres;
    // negative: a percentage of the screen's height; 0: 5 % of it).
    void SetPointDisplay(int mode, double size);

    // ---- Entities, drawn in the model space or, between BeginBlock and EndBlock, in that block. Each
    // returns false, and draws nothing, when a coordinate (or a size) is not a finite number.

    bool Point(int layer, Point3 at);
    // A text of one line; an empty text draws nothing and is not an error.
    bool Text(int layer, Point3 at, std::string_view text, const TextStyle& style);
    bool Line(int layer, Point3 from, Point3 to);
    // A polyline through the vertices: a 3D one keeps each vertex's Z; a 2D one lies at the Z of its
    // first vertex. A closed one returns to its first vertex. Fewer than two vertices draw nothing.
    bool Polyline(int layer, std::span<const Point3> vertices, bool closed, bool is3D);

    // ---- Blocks: a symbol defined once and inserted many times.

    // Starts the definition of a block (its name made valid); `base` is the point of the block that an
    // insertion puts at its insertion point. False when a block of that name exists or one is open.
    bool BeginBlock(std::string_view name, Point3 base = {});
    void EndBlock();
    // Draws the block of that name (made valid) at `at`, scaled and turned about its base point. False
    // when no such block was defined (and ended) before, or inside a block's definition.
    bool Insert(int layer, std::string_view block, Point3 at, double scale = 1.0, double rotationGrads = 0.0);

    // ---- The file.

    // Whether anything was drawn in the model space.
    bool IsEmpty() const { return !m_extents.any; }
    // Room for that many bytes of entities, when their number is known: no copy while they grow.
    void Reserve(std::size_t bytes) { m_entities.reserve(bytes); }
    // The whole file: HEADER, TABLES, BLOCKS, ENTITIES, EOF, in the writer's own memory, valid as long as
    // the writer. An open block is ended first. Called once, at the end: the file is assembled in the
    // entities' buffer, a million entities not copied into a second one.
    std::string_view Finish();

    // ---- A drawing drawn twice, measured and then streamed.

    // From now on the entities of the model space only count for the extents and the layers.
    void Measure();
    // Hands `sink` the header, the tables and the blocks of what was measured (blocks must be defined
    // by then), then the entities drawn again after it: by Flush once they reach a chunk, the rest and
    // the end of the file by Finish, which then returns nothing.
    void Stream(std::function<void(std::string_view)> sink);
    // Called after each entity, or group of them, while streaming.
    void Flush();

private:
    struct Box {
        bool any = false;
        Point3 min;
        Point3 max;
        void Add(const Point3& p);
        void Add(const Box& other);
    };
    struct LayerEntry {
        std::string name;
        int colour;
    };
    // The text of the file, in memory taken in huge pages when it grows big: a drawing of a million
    // points fills some 200 MB, which in pages of 4 KB would cost fifty thousand page faults.
    using Buffer = std::pmr::string;

    struct Block {
        std::string name;
        Point3 base;
        Buffer body;
        Box extents;
    };

    static constexpr std::size_t kStreamChunk = std::size_t{1} << 20;

    Buffer& Body() { return m_inBlock ? m_blocks.back().body : m_entities; }
    // Whether the entity being drawn only counts for the extents: measured, outside a block.
    bool Measuring() const { return m_measuring && !m_inBlock; }
    void AddTextExtents(const Point3& at, std::string_view text, const TextStyle& style);
    // HEADER, TABLES, BLOCKS and the start of ENTITIES.
    void AppendHead(Buffer& head) const;
    Box& Extents() { return m_inBlock ? m_blocks.back().extents : m_extents; }
    void Start(Buffer& out, std::string_view kind, int layer) const;
    void Coordinates(Buffer& out, int code, const Point3& p) const;
    void Number(Buffer& out, int code, double value) const;
    void AppendHeader(Buffer& out) const;
    void AppendTables(Buffer& out) const;
    void AppendViewport(Buffer& out) const;
    void AppendBlocks(Buffer& out) const;

    int m_decimals;
    std::vector<LayerEntry> m_layers;
    std::unordered_map<std::string, int> m_layerNumbers;
    std::vector<Block> m_blocks;
    bool m_inBlock = false;
    Buffer m_entities;
    Box m_extents;
    // The sine and cosine of the last text's rotation, kept: a million texts share one rotation.
    double m_rotationGrads = 0.0;
    double m_sin = 0.0;
    double m_cos = 1.0;
    // The text of the last height written: a million texts share one height.
    double m_height = 0.0;
    Buffer m_heightText{"0"};
    int m_pointMode = 0;
    double m_pointSize = 0.0;
    bool m_measuring = false;
    std::function<void(std::string_view)> m_sink;
};

} // namespace pyr::dxf
