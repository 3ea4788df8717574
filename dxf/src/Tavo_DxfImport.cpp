// Tavo_DxfImport: parse, measure, count, build.
#include "Tavo_DxfImport.h"

#include "Tavo_DxfDrawingSink.h"
#include "Tavo_DxfParser.h"
#include "Tavo_DxfWalker.h"
#include "Tavo_GrDrawing.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <memory>

namespace {

// Curves are cut finely enough that at the deepest zoom a drawing window
// offers (the whole drawing about a thousand times a screen's width) a chord
// lies within a pixel of its curve.
constexpr double kFlatteningShareOfSpan = 1.0 / (1 << 21);

// Collects the extents of everything drawn.
class ExtentsSink : public Tavo_DxfSink {
public:
    void Dot(const Tavo_DxfStyle&, const Tavo_DxfXY& p) override { Add(p); }
    void Line(const Tavo_DxfStyle&, const Tavo_DxfXY& p, const Tavo_DxfXY& q) override
    {
        Add(p);
        Add(q);
    }
    void Polyline(const Tavo_DxfStyle&, const std::vector<Tavo_DxfXY>& points, bool) override
    {
        for (const Tavo_DxfXY& p : points)
            Add(p);
    }
    void Polygon(const Tavo_DxfStyle&, const Tavo_DxfXY* points, int count) override
    {
        for (int i = 0; i < count; ++i)
            Add(points[i]);
    }
    void Circle(const Tavo_DxfStyle&, const Tavo_DxfXY& c, double r) override
    {
        Add({c.x - r, c.y - r});
        Add({c.x + r, c.y + r});
    }
    void Text(const Tavo_DxfStyle&, const Tavo_DxfTextPlacement& placement, const std::string&) override
    {
        Add({placement.anchor.x, placement.anchor.y - placement.height});
        Add({placement.anchor.x, placement.anchor.y + placement.height});
    }

    bool IsEmpty() const { return m_empty; }
    double MinX() const { return m_minX; }
    double MinY() const { return m_minY; }
    double MaxX() const { return m_maxX; }
    double MaxY() const { return m_maxY; }

private:
    void Add(const Tavo_DxfXY& p)
    {
        if (m_empty) {
            m_minX = m_maxX = p.x;
            m_minY = m_maxY = p.y;
            m_empty = false;
            return;
        }
        m_minX = std::min(m_minX, p.x);
        m_minY = std::min(m_minY, p.y);
        m_maxX = std::max(m_maxX, p.x);
        m_maxY = std::max(m_maxY, p.y);
    }

    bool m_empty = true;
    double m_minX = 0.0, m_minY = 0.0, m_maxX = 0.0, m_maxY = 0.0;
};

// The power of ten that brings the span to between a tenth of kWorldSpan and
// kWorldSpan.
double ScaleForSpan(double span)
{
    if (!(span > 0.0))
        span = 1.0;
    double scale = std::pow(10.0, std::floor(std::log10(Tavo_DxfImportResult::kWorldSpan / span)));
    while (span * scale > Tavo_DxfImportResult::kWorldSpan)
        scale /= 10.0;
    return scale;
}

Tavo_DxfImportResult Refused(int line, std::string text)
{
    Tavo_DxfImportResult result;
    result.ok = false;
    result.error.line = line;
    result.error.text = std::move(text);
    return result;
}

} // namespace

Tavo_DxfImportResult Tavo_DxfImport(const char* data, size_t size, Tavo_GrDrawing& drawing,
                                    Tavo_DxfColourResolver& colours, const Tavo_DxfLimits& limits)
{
    if (size > limits.maxInputBytes)
        return Refused(0, "the file is larger than " + std::to_string(limits.maxInputBytes) + " bytes, the most an import reads");

    Tavo_DxfWarnings warnings(limits.maxWarnings);
    Tavo_DxfImportResult result;
    auto finish = [&](Tavo_DxfImportResult& r) {
        warnings.Deliver(r.warnings, r.droppedWarnings);
        return r;
    };

    Tavo_DxfModel model;
    Tavo_DxfParser parser(data, size, warnings);
    if (!parser.Parse(model)) {
        Tavo_DxfImportResult refused = Refused(parser.ErrorLine(), parser.Error());
        return finish(refused);
    }
    result.version = model.version;
    result.entitiesRead = parser.EntitiesRead();

    // Walk 1: the extents, at a coarse flattening, with the warnings.
    ExtentsSink extents;
    Tavo_DxfWalker measuring(model, extents, Tavo_DxfFlattening(), limits, &warnings);
    if (!measuring.Walk()) {
        Tavo_DxfImportResult refused = Refused(measuring.ErrorLine(), measuring.Error());
        return finish(refused);
    }
    result.entitiesSkipped = parser.EntitiesSkipped() + measuring.Skipped();
    const double spanX = extents.MaxX() - extents.MinX();
    const double spanY = extents.MaxY() - extents.MinY();
    const double span = std::max(spanX, spanY);
    result.scale = ScaleForSpan(span);
    result.originX = extents.IsEmpty() ? 0.0 : extents.MinX() + spanX / 2.0;
    result.originY = extents.IsEmpty() ? 0.0 : extents.MinY() + spanY / 2.0;
    if (extents.IsEmpty())
        warnings.Add(0, "the drawing has nothing to draw");

    // Walk 2: the counts at the final flattening, so that walk 3 cannot fail
    // half-way through filling the caller's drawing.
    Tavo_DxfFlattening fine;
    fine.tolerance = (span > 0.0 ? span : 1.0) * kFlatteningShareOfSpan;
    Tavo_DxfNullSink nothing;
    Tavo_DxfWalker counting(model, nothing, fine, limits, nullptr);
    if (!counting.Walk()) {
        Tavo_DxfImportResult refused = Refused(counting.ErrorLine(), counting.Error());
        return finish(refused);
    }

    // Walk 3: build.
    const int firstLayer = drawing.GetLayerCount();
    Tavo_DxfDrawingSink sink(drawing, firstLayer, colours, result.scale, result.originX, result.originY);
    for (const Tavo_DxfLayer& layer : model.layers)
        sink.Builder().BeginLayer(layer.name.c_str());
    if (!model.layers.empty())
        sink.Builder().Reserve(0, static_cast<int>(std::min<long long>(counting.Points(), limits.maxPoints)));
    const int itemsBefore = drawing.GetItemCount();
    Tavo_DxfWalker building(model, sink, fine, limits, nullptr);
    building.Walk();
    for (size_t i = 0; i < model.layers.size(); ++i)
        if (model.layers[i].frozen || model.layers[i].colour < 0)
            drawing.SetLayerVisible(firstLayer + static_cast<int>(i), false);

    result.ok = true;
    result.itemsMade = drawing.GetItemCount() - itemsBefore;
    result.layersMade = static_cast<int>(model.layers.size());
    return finish(result);
}

Tavo_DxfImportResult Tavo_DxfImportFile(const char* path, Tavo_GrDrawing& drawing, Tavo_DxfColourResolver& colours,
                                        const Tavo_DxfLimits& limits)
{
    if (!path)
        return Refused(0, "no file named");
    std::unique_ptr<FILE, int (*)(FILE*)> file(std::fopen(path, "rb"), &std::fclose);
    if (!file)
        return Refused(0, std::string("cannot open ") + path);
    if (std::fseek(file.get(), 0, SEEK_END) != 0)
        return Refused(0, std::string("cannot read ") + path);
    const long length = std::ftell(file.get());
    if (length < 0)
        return Refused(0, std::string("cannot read ") + path);
    if (static_cast<unsigned long>(length) > limits.maxInputBytes)
        return Refused(0, "the file is larger than " + std::to_string(limits.maxInputBytes) + " bytes, the most an import reads");
    std::rewind(file.get());
    std::string text(static_cast<size_t>(length), '\0');
    if (length > 0 && std::fread(&text[0], 1, text.size(), file.get()) != text.size())
        return Refused(0, std::string("cannot read ") + path);
    return Tavo_DxfImport(text.data(), text.size(), drawing, colours, limits);
}
