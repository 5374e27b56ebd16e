#include "ShapeTestUtil.h"

#include "orbane/ShapeFile.h"
#include "orbane/SvgPath.h"

#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <fstream>

namespace Orbane::ShapeTests {

namespace {

class Files : public ::testing::Test
{
protected:
    std::string Put(const char *name, const std::string &text)
    {
        const std::string path = mDir.filePath(name).toStdString();
        std::ofstream(path) << text;
        return path;
    }
    std::string Path(const char *name) const { return mDir.filePath(name).toStdString(); }
    QTemporaryDir mDir;
};

std::string Svg(const std::string &d, const char *extra = "")
{
    return std::string("<?xml version=\"1.0\"?>\n<svg xmlns=\"http://www.w3.org/2000/svg\" viewBox=\"0 0 100 100\" ") +
           extra + ">\n  <path d=\"" + d + "\"/>\n</svg>\n";
}

struct SvgCase
{
    const char *name;
    const char *d;
    int count;
    bool closed;
    float64 par;     // a place on the shape
    OrbPoint expect; // where it is, in image coordinates
};

class SvgCommands : public Files, public ::testing::WithParamInterface<SvgCase>
{
};

TEST_P(SvgCommands, ReadIntoImageCoordinates)
{
    const SvgCase &c = GetParam();
    std::string why;
    AutoRef<PolyLine> s(SvgPath::Read(Put("a.svg", Svg(c.d)), &why));
    ASSERT_TRUE(s.IsValid()) << why;
    EXPECT_EQ(s->GetCount(), c.count);
    EXPECT_EQ(s->IsClosed(), c.closed);
    EXPECT_NEAR((s->ValueAt(c.par) - c.expect).Length(), 0.0, 1e-9);
}

INSTANTIATE_TEST_SUITE_P(
    Paths, SvgCommands,
    ::testing::Values(SvgCase{"Lines", "M10 10 L90 10 L90 90 Z", 3, true, 1.0, {0.9, 0.9}},
                      SvgCase{"Relative", "m10 10 l80 0 l0 80 z", 3, true, 2.0, {0.9, 0.1}},
                      SvgCase{"HorizontalVertical", "M10,10h80v80z", 3, true, 2.5, {0.5, 0.5}},
                      SvgCase{"ImplicitLinesAfterMove", "M10 10 90 10 90 90", 3, false, 2.0, {0.9, 0.1}},
                      SvgCase{"CubicAndSmooth", "M10 50 C10 10 90 10 90 50 S10 90 10 50 Z", 2, true, 0.5, {0.5, 0.8}},
                      SvgCase{"QuadraticAndSmooth", "M0 100 Q50 0 100 100 T200 100", 3, false, 0.5, {0.5, 0.5}},
                      SvgCase{"Arc", "M0 50 A50 50 0 0 1 100 50", 3, false, 1.0, {0.5, 1.0}},
                      SvgCase{"ArcFlagsTouching", "M0 50a50,50 0 01100,0", 3, false, 1.0, {0.5, 1.0}},
                      SvgCase{"Exponents", "M1e1 1E1L9e+1 10", 2, false, 1.0, {0.9, 0.9}},
                      SvgCase{"FirstSubpathOnly", "M10 10 L20 10 Z M50 50 L60 60", 2, true, 0.0, {0.1, 0.9}}),
    [](const auto &info) { return std::string(info.param.name); });

TEST_F(Files, SvgWithGroupTransformsAndSizeOnly)
{
    const std::string text = "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"200\" height=\"100\">\n"
                             "<g transform=\"translate(100,0)\"><g transform=\"scale(2 1)\">\n"
                             "<path transform=\"matrix(1 0 0 1 0 50)\" d=\"M0 0 L25 0\"/></g></g></svg>";
    std::string why;
    AutoRef<PolyLine> s(SvgPath::Read(Put("g.svg", text), &why));
    ASSERT_TRUE(s.IsValid()) << why;
    EXPECT_NEAR((s->First()->Pos() - OrbPoint(0.5, 0.5)).Length(), 0.0, 1e-12);
    EXPECT_NEAR((s->Last()->Pos() - OrbPoint(0.75, 0.5)).Length(), 0.0, 1e-12);
}

TEST_F(Files, SvgRoundTripKeepsCurvesAndCorners)
{
    AutoRef<PolyLine> shape(new PolyLine);
    shape->MakeEllipse(0.4, 0.6, 0.2, 0.1, 5);
    const uint8 one[] = {0, 0, 1, 0, 0};
    shape->Linear(one);
    std::string why;
    ASSERT_TRUE(SvgPath::Write(Path("out.svg"), *shape, 640, 480, &why)) << why;
    AutoRef<PolyLine> back(SvgPath::Read(Path("out.svg"), &why));
    ASSERT_TRUE(back.IsValid()) << why;
    ASSERT_EQ(back->GetCount(), shape->GetCount());
    EXPECT_TRUE(back->IsClosed());
    for (int32 i = 0; i < shape->GetCount(); ++i) {
        EXPECT_NEAR((back->GetPoint(i)->Pos() - shape->GetPoint(i)->Pos()).Length(), 0.0, 1e-12) << i;
        EXPECT_NEAR((back->GetPoint(i)->In() - shape->GetPoint(i)->In()).Length(), 0.0, 1e-12) << i;
        EXPECT_NEAR((back->GetPoint(i)->Out() - shape->GetPoint(i)->Out()).Length(), 0.0, 1e-12) << i;
    }
}

struct BadCase
{
    const char *name;
    std::string text;
    const char *where; // what the message must name
};

class BadSvg : public Files, public ::testing::WithParamInterface<BadCase>
{
};

TEST_P(BadSvg, RefusedWithFileAndPosition)
{
    const std::string path = Put("bad.svg", GetParam().text);
    std::string why;
    EXPECT_EQ(AutoRef<PolyLine>(SvgPath::Read(path, &why)).get(), nullptr);
    EXPECT_NE(why.find(path), std::string::npos) << why;
    EXPECT_NE(why.find(GetParam().where), std::string::npos) << why;
}

INSTANTIATE_TEST_SUITE_P(
    Files, BadSvg,
    ::testing::Values(BadCase{"MissingNumber", Svg("M10 10 L 20"), "line 3, column 4: path data, character 12"},
                      BadCase{"UnsupportedCommand", Svg("M10 10 X 5 5"), "character 8: unsupported"},
                      BadCase{"NoMoveFirst", Svg("L10 10"), "character 1: a path starts with M"},
                      BadCase{"NotANumber", Svg("M nan 10"), "character 3: expected a number"},
                      BadCase{"BadArcFlag", Svg("M0 0 A5 5 0 2 1 10 10"), "arc flag"},
                      BadCase{"BrokenXml", "<svg viewBox=\"0 0 1 1\">\n<path d=\"M0 0 L1 1\">\n</svg>", "line 3"},
                      BadCase{"NoSize", "<svg><path d=\"M0 0 L1 1\"/></svg>", "viewBox"},
                      BadCase{"UnknownTransform",
                              "<svg viewBox=\"0 0 1 1\">\n<path transform=\"skewX(3)\" d=\"M0 0 L1 1\"/></svg>",
                              "line 2, column 2: unsupported transform"}),
    [](const auto &info) { return std::string(info.param.name); });

TEST_F(Files, ShapeFileRoundTripKeepsEveryField)
{
    AutoRef<BSplinePolyLine> shape = MakeShape<BSplinePolyLine>({{0.1, 0.2}, {0.7, 0.3}, {0.5, 0.9}}, true);
    PolyPoint p = *shape->GetPoint(1);
    p.Weight = 2.5, p.Pressure = 0.25, p.Time = 1.5, p.Rotation = 30;
    shape->SetPoint(1, p);
    shape->PublishPoints(nullptr);
    std::string why;
    ASSERT_TRUE(ShapeFile::Export(Path("s.shape"), *shape, 1, 1, &why)) << why;
    AutoRef<PolyLine> back(ShapeFile::Import(Path("s.shape"), &why));
    ASSERT_TRUE(back.IsValid()) << why;
    EXPECT_TRUE(back->Equals(*shape)) << ShapeFile::Text(*back);
}

TEST_F(Files, BadShapeFilesNameTheirLine)
{
    const std::string head = "orbane-shape 1\nkind bezier\n";
    const std::pair<std::string, const char *> cases[] = {
        {head + "point x=0.1 y=nan\n", "line 3, column 15: y must be a finite number"},
        {head + "point x=0.1 y=0.2\npoint x=0.3\n", "line 4: point 2: needs x and y"},
        {head + "closed maybe\n", "line 3, column 1: bad value"},
        {"shape\n", "line 1, column 1: a shape file starts with"},
        {head + "point x=0.1 y=0.2 weight=0\n", "line 3: point 1: weight"},
    };
    for (const auto &[text, where] : cases) {
        std::string why;
        EXPECT_EQ(AutoRef<PolyLine>(ShapeFile::Import(Put("bad.shape", text), &why)).get(), nullptr) << text;
        EXPECT_NE(why.find(where), std::string::npos) << why;
    }
}

} // namespace

} // namespace Orbane::ShapeTests
