#include "orbane/SvgPath.h"

#include "SvgPathData.h"
#include "orbane/AutoRef.h"
#include "orbane/ClassIDs.h"
#include "orbane/PolyLine.h"

#include <pugixml.hpp>

#include <cmath>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <sstream>

namespace Orbane {

namespace {

constexpr float64 kPi = 3.14159265358979323846;

// An affine map x' = a x + c y + e, y' = b x + d y + f, as SVG writes it.
struct Affine
{
    float64 a = 1, b = 0, c = 0, d = 1, e = 0, f = 0;
    Affine operator*(const Affine &o) const
    {
        return {a * o.a + c * o.b, b * o.a + d * o.b,     a * o.c + c * o.d,
                b * o.c + d * o.d, a * o.e + c * o.f + e, b * o.e + d * o.f + f};
    }
    OrbPoint operator()(const OrbPoint &p) const { return {a * p.x + c * p.y + e, b * p.x + d * p.y + f}; }
};

// Line and column (from 1) of a byte offset.
std::string Where(const std::string &text, std::ptrdiff_t offset)
{
    int line = 1, column = 1;
    for (std::ptrdiff_t i = 0; i < offset && i < std::ptrdiff_t(text.size()); ++i)
        text[std::size_t(i)] == '\n' ? (++line, column = 1) : ++column;
    return "line " + std::to_string(line) + ", column " + std::to_string(column);
}

// The numbers of a transform function's argument list.
std::vector<float64> Args(const std::string &list)
{
    std::vector<float64> v;
    std::string s = list;
    for (char &ch : s)
        if (ch == ',')
            ch = ' ';
    std::istringstream in(s);
    for (float64 x; in >> x;)
        v.push_back(x);
    return v;
}

bool ParseTransform(const char *text, Affine &out, std::string &why)
{
    const std::string s(text);
    std::size_t at = 0;
    while ((at = s.find_first_not_of(" \t\r\n,", at)) != std::string::npos) {
        const std::size_t open = s.find('(', at), close = s.find(')', at);
        if (open == std::string::npos || close == std::string::npos || close < open) {
            why = "unreadable transform \"" + s + "\"";
            return false;
        }
        std::string name = s.substr(at, open - at);
        name.erase(name.find_last_not_of(" \t") + 1);
        const std::vector<float64> v = Args(s.substr(open + 1, close - open - 1));
        Affine m;
        if (name == "matrix" && v.size() == 6)
            m = {v[0], v[1], v[2], v[3], v[4], v[5]};
        else if (name == "translate" && (v.size() == 1 || v.size() == 2))
            m.e = v[0], m.f = v.size() == 2 ? v[1] : 0.0;
        else if (name == "scale" && (v.size() == 1 || v.size() == 2))
            m.a = v[0], m.d = v.size() == 2 ? v[1] : v[0];
        else if (name == "rotate" && (v.size() == 1 || v.size() == 3)) {
            const float64 r = v[0] * kPi / 180.0, cx = v.size() == 3 ? v[1] : 0.0, cy = v.size() == 3 ? v[2] : 0.0;
            const Affine rot{std::cos(r), std::sin(r), -std::sin(r), std::cos(r), 0, 0};
            m = Affine{1, 0, 0, 1, cx, cy} * rot * Affine{1, 0, 0, 1, -cx, -cy};
        } else {
            why = "unsupported transform \"" + name + "\"";
            return false;
        }
        out = out * m;
        at = close + 1;
    }
    return true;
}

// The first path element in document order, with the transform down to it.
pugi::xml_node FindPath(pugi::xml_node node, Affine &ctm, std::string &why)
{
    for (pugi::xml_node child : node.children()) {
        if (child.type() != pugi::node_element)
            continue;
        Affine here = ctm;
        if (const pugi::xml_attribute t = child.attribute("transform"); t && !ParseTransform(t.value(), here, why))
            return child;
        if (std::strcmp(child.name(), "path") == 0) {
            ctm = here;
            return child;
        }
        if (pugi::xml_node found = FindPath(child, here, why); found || !why.empty()) {
            ctm = here;
            return found;
        }
    }
    return {};
}

// The document's user box: its viewBox, or 0 0 width height.
bool UserBox(pugi::xml_node svg, float64 box[4])
{
    if (const char *vb = svg.attribute("viewBox").as_string(nullptr)) {
        const std::vector<float64> v = Args(vb);
        if (v.size() == 4 && v[2] > 0 && v[3] > 0) {
            std::copy(v.begin(), v.end(), box);
            return true;
        }
        return false;
    }
    box[0] = box[1] = 0.0;
    box[2] = svg.attribute("width").as_double(0.0), box[3] = svg.attribute("height").as_double(0.0);
    return box[2] > 0 && box[3] > 0;
}

PolyLine *Build(const SvgPathData::Subpath &sub, const Affine &ctm, const float64 box[4])
{
    auto image = [&](const OrbPoint &p) {
        const OrbPoint u = ctm(p);
        return OrbPoint((u.x - box[0]) / box[2], 1.0 - (u.y - box[1]) / box[3]);
    };
    std::vector<PolyPoint> pts;
    const OrbPoint s = image(sub.start);
    pts.emplace_back(s.x, s.y);
    for (const SvgPathData::Cubic &c : sub.pieces) {
        const OrbPoint c1 = image(c.c1), c2 = image(c.c2), end = image(c.end);
        pts.back().OutX = c1.x, pts.back().OutY = c1.y;
        PolyPoint k(end.x, end.y);
        k.InX = c2.x, k.InY = c2.y;
        pts.push_back(k);
    }
    // A closed path ends on its start: that end is the first point's in side.
    if (sub.closed && pts.size() > 2 && (pts.back().Pos() - pts.front().Pos()).Length() < 1e-12) {
        pts.front().InX = pts.back().InX, pts.front().InY = pts.back().InY;
        pts.pop_back();
    }
    AutoRef<PolyLine> shape(new PolyLine);
    for (const PolyPoint &p : pts)
        if (!shape->AddPoint(p))
            return nullptr;
    if (sub.closed)
        shape->Close();
    return shape.Take();
}

std::string Num(float64 v)
{
    char buf[32];
    std::snprintf(buf, sizeof buf, "%.17g", v);
    return buf;
}

} // namespace

PolyLine *SvgPath::Read(const std::string &file, std::string *error)
{
    auto fail = [&](const std::string &why) {
        if (error)
            *error = file + ": " + why;
        return nullptr;
    };
    std::ifstream in(file, std::ios::binary);
    if (!in)
        return fail("cannot open the file");
    const std::string text((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    pugi::xml_document doc;
    const pugi::xml_parse_result parsed = doc.load_buffer(text.data(), text.size());
    if (!parsed)
        return fail(Where(text, parsed.offset) + ": " + parsed.description());
    const pugi::xml_node svg = doc.child("svg");
    float64 box[4];
    if (!svg || !UserBox(svg, box))
        return fail("not an SVG document with a viewBox or a width and height");
    Affine ctm;
    std::string why;
    const pugi::xml_node path = FindPath(svg, ctm, why);
    if (!why.empty())
        return fail(Where(text, path.offset_debug()) + ": " + why);
    if (!path)
        return fail("no path element");
    std::vector<SvgPathData::Subpath> subs;
    if (!SvgPathData::Parse(path.attribute("d").as_string(nullptr), subs, &why))
        return fail(Where(text, path.offset_debug()) + ": path data, " + (why.empty() ? "no d attribute" : why));
    if (subs.empty())
        return fail(Where(text, path.offset_debug()) + ": the path draws nothing");
    PolyLine *shape = Build(subs.front(), ctm, box);
    return shape ? shape : fail(Where(text, path.offset_debug()) + ": a coordinate is not finite");
}

std::string SvgPath::PathData(const PolyLine &shape, float64 width, float64 height)
{
    AutoRef<PolyLine> bezier(shape.Convert(CLSID_DataType_Polyline));
    const std::vector<PolyPoint> &pts = bezier->Points();
    if (pts.empty())
        return {};
    auto xy = [&](float64 x, float64 y) { return Num(x * width) + "," + Num((1.0 - y) * height); };
    std::string d = "M " + xy(pts[0].X, pts[0].Y);
    for (int32 s = 0; s < bezier->GetSegmentsCount(); ++s) {
        const PolyPoint &a = pts[std::size_t(s)], &b = pts[std::size_t(s + 1) % pts.size()];
        const bool line = a.Out() == a.Pos() && b.In() == b.Pos();
        if (line && bezier->IsClosed() && s == bezier->GetSegmentsCount() - 1)
            break; // Z draws the straight way home
        d += line ? " L " + xy(b.X, b.Y) : " C " + xy(a.OutX, a.OutY) + " " + xy(b.InX, b.InY) + " " + xy(b.X, b.Y);
    }
    return bezier->IsClosed() ? d + " Z" : d;
}

bool SvgPath::Write(const std::string &file, const PolyLine &shape, float64 width, float64 height, std::string *error)
{
    pugi::xml_document doc;
    pugi::xml_node svg = doc.append_child("svg");
    svg.append_attribute("xmlns") = "http://www.w3.org/2000/svg";
    svg.append_attribute("width") = width;
    svg.append_attribute("height") = height;
    svg.append_attribute("viewBox") = ("0 0 " + Num(width) + " " + Num(height)).c_str();
    pugi::xml_node path = svg.append_child("path");
    path.append_attribute("d") = PathData(shape, width, height).c_str();
    path.append_attribute("fill") = "none";
    path.append_attribute("stroke") = "black";
    if (doc.save_file(file.c_str()))
        return true;
    if (error)
        *error = file + ": cannot write the file";
    return false;
}

} // namespace Orbane
