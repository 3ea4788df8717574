// Tavo_GrAttr: the drawing attribute of one item of a drawing.
//
//   colour       signed 8-bit colour index of the palette (Tavo_GrPalette):
//                0 upward name palette entries; -1 transparent, -2 inherit,
//                -3 default
//   fill         8-bit fill code: 0 draws outlines only (the surface's hollow
//                flag), any other value fills closed shapes (1 = "solid")
//   charHeight   character height of text, in world units
//   textAlign    8-bit text alignment code: bits 0-1 horizontal (1 left,
//                2 right, 3 centre; 0 counts as left), bits 2-3 vertical
//                (4 bottom, 8 top, 12 middle; 0 counts as bottom)
//
// Surfaces receive attributes by pointer (Tavo_GrSurface's drawing
// operations) and never write through it.
#pragma once

class Tavo_GrAttr {
public:
    enum TextAlign : char {
        AlignLeft = 1,
        AlignRight = 2,
        AlignCentre = 3,
        AlignBottom = 4,
        AlignTop = 8,
        AlignMiddle = 12,
        AlignDefault = AlignLeft | AlignBottom, // 5
    };
    // The bits of an alignment code that hold its horizontal and its vertical part.
    static constexpr char kHorizontalAlignMask = 3;
    static constexpr char kVerticalAlignMask = 12;

    constexpr Tavo_GrAttr() = default;
    constexpr Tavo_GrAttr(char color, char fill, int charHeight = 0, char textAlign = AlignDefault)
        : m_color(color), m_fill(fill), m_charHeight(charHeight), m_textAlign(textAlign)
    {
    }

    char GetColor() const { return m_color; }
    char GetFill() const { return m_fill; }
    int GetCharHeight() const { return m_charHeight; }
    char GetTextAlign() const { return m_textAlign; }
    bool IsHollow() const { return m_fill == 0; }

    void SetColor(char color) { m_color = color; }
    void SetFill(char fill) { m_fill = fill; }
    void SetCharHeight(int charHeight) { m_charHeight = charHeight; }
    void SetTextAlign(char textAlign) { m_textAlign = textAlign; }

    bool operator==(const Tavo_GrAttr& other) const
    {
        return m_color == other.m_color && m_fill == other.m_fill && m_charHeight == other.m_charHeight && m_textAlign == other.m_textAlign;
    }
    bool operator!=(const Tavo_GrAttr& other) const { return !(*this == other); }

private:
    char m_color = 0;
    char m_fill = 0;
    int m_charHeight = 0;
    char m_textAlign = AlignDefault;
};
