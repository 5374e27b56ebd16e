#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/ImageParam.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag IO_AngleInput = 0x10058000, IO_XSizeInput = 0x10058001, IO_FitImage = 0x10058008, IO_FlipX = 0x10058009;
constexpr Tag IO_ShowHandles = 0x1005800b, IO_HideWhileDragging = 0x1005800e;
constexpr Tag IOD_FrameWidth = 0x20058000, IOD_Opacity = 0x20058003, IOD_Gain = 0x20058004;
constexpr Tag IOD_CropRight = 0x20058007, IOID_Image = 0x80058000, IOID_Visible = 0x80058002;
constexpr Tag IOP_Opacity = 0x60058001;

// A 100 x 100 image: white on its left half, mid grey on its right.
QImage Halves()
{
    QImage image(100, 100, QImage::Format_ARGB32);
    image.fill(QColor(128, 128, 128));
    for (int y = 0; y < 100; ++y)
        for (int x = 0; x < 50; ++x)
            image.setPixel(x, y, qRgb(255, 255, 255));
    return image;
}

// Center (the overlay's Input) and X Size (its Input 1, no angle), the picture, an opacity and a
// visibility switch; the frame half the image wide, as high as the picture.
Input *AddOverlay(ViewerFixture &f, const TagList &more = TagList())
{
    f.tool->AddInput(OrbID("Picture"), "Picture", CLSID_DataType_Image, TagList(),
                     AutoRef<ImageParam>(new ImageParam("halves", Halves())).get());
    f.tool->AddInput(OrbID("Opacity"), "Opacity", CLSID_DataType_Number, TagList(), AutoNumber(1.0));
    f.tool->AddInput(OrbID("Visible"), "Visible", CLSID_DataType_Number, TagList(), AutoNumber(1.0));
    TagList attrs{{INPA_PreviewControl, OrbID("ImgOverlayControl")},
                  {INPA_OverlayInput, OrbID("XSize")},
                  {IO_AngleInput, 2}, // none: no Input 2
                  {IO_XSizeInput, 1},
                  {IOD_FrameWidth, 0.5},
                  {IO_FitImage, true},
                  {IOID_Image, OrbID("Picture")},
                  {IOID_Visible, OrbID("Visible")}};
    attrs.Append(more);
    Input *c = f.AddPoint("Center", 0.5, 0.5, attrs);
    f.tool->AddInput(OrbID("XSize"), "XSize", CLSID_DataType_Number, TagList(), AutoNumber(1.0));
    return c;
}

// The grey level 50 viewer pixels left and right of the centre: the
// frame is 200 pixels square about it at zoom 1.
std::pair<int, int> Sides(ViewerFixture &f)
{
    const QImage shot = f.Grab();
    return {qGray(shot.pixel(f.At({0.5, 0.5}, QPoint(-50, 20)))), qGray(shot.pixel(f.At({0.5, 0.5}, QPoint(50, 20))))};
}

} // namespace

class ImgOverlayControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        std::string why;
        QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
    }

    void look_data();
    void look();
    void opacityFromInput();
    void handlesMoveAndScaleIt();
    void hiddenWhileDragging();
};

void ImgOverlayControlTest::look_data()
{
    QTest::addColumn<TagList>("tags");
    QTest::addColumn<bool>("hide"); // the visibility Input set to 0
    QTest::addColumn<int>("leftLo");
    QTest::addColumn<int>("leftHi");
    QTest::addColumn<int>("rightLo");
    QTest::addColumn<int>("rightHi");
    QTest::newRow("as it is") << TagList() << false << 250 << 255 << 120 << 136;
    QTest::newRow("half opacity") << TagList{{IOD_Opacity, 0.5}} << false << 120 << 136 << 56 << 72;
    QTest::newRow("half gain") << TagList{{IOD_Gain, 0.5}} << false << 120 << 136 << 56 << 72;
    QTest::newRow("flipped: the white on the right") << TagList{{IO_FlipX, true}} << false << 120 << 136 << 250 << 255;
    QTest::newRow("right half cropped away") << TagList{{IOD_CropRight, 0.5}} << false << 250 << 255 << 0 << 10;
    QTest::newRow("hidden by its Input") << TagList() << true << 0 << 10 << 0 << 10;
}

Q_DECLARE_METATYPE(Orbane::TagList)

// What the tags do to the picture, read off the viewer's pixels over the
// black image.
void ImgOverlayControlTest::look()
{
    QFETCH(TagList, tags);
    QFETCH(bool, hide);
    QFETCH(int, leftLo);
    QFETCH(int, leftHi);
    QFETCH(int, rightLo);
    QFETCH(int, rightHi);
    ViewerFixture f;
    AddOverlay(f, tags);
    if (hide)
        f.tool->FindInput(OrbID("Visible"))->SetValue(AutoNumber(0.0).get(), f.doc.GetCurrentTime());
    QVERIFY(f.Show());
    const auto [left, right] = Sides(f);
    QVERIFY2(left >= leftLo && left <= leftHi && right >= rightLo && right <= rightHi,
             qPrintable(QString("%1 %2").arg(left).arg(right)));
}

// The opacity follows a linked Input as it changes.
void ImgOverlayControlTest::opacityFromInput()
{
    ViewerFixture f;
    Input *c = AddOverlay(f);
    Input *opacity = f.tool->FindInput(OrbID("Opacity"));
    QVERIFY(f.Show());
    PreviewControl *overlay = f.OverlayOf(c);
    overlay->SetAttrsTagList(TagList{{IOP_Opacity, static_cast<void *>(static_cast<ScriptObject *>(opacity))}});
    QVERIFY(Sides(f).first > 250);
    opacity->SetValue(AutoNumber(0.25).get(), f.doc.GetCurrentTime());
    QCOMPARE(StateOf(overlay, "opacity"), 0.25);
    QVERIFY(std::abs(Sides(f).first - 64) < 8);
}

// The transform's handles work on the picture's frame: the +X knob sits on
// the fitted frame's side and scales it; without handles nothing is grabbed.
void ImgOverlayControlTest::handlesMoveAndScaleIt()
{
    ViewerFixture f;
    Input *c = AddOverlay(f);
    QVERIFY(f.Show());
    const QPoint side = f.At({0.5, 0.5}, QPoint(100, 0)), top = f.At({0.5, 0.5}, QPoint(0, 100));
    f.Hover(top);
    QCOMPARE(StateOf(f.OverlayOf(c), "hoverPart"), 32.0);
    f.Drag(side, side + QPoint(50, 0), 4);
    QCOMPARE(NumberOf(f, "XSize"), 1.5);
    QCOMPARE(f.doc.UndoNames(), QStringList{"Scale Transform"});

    ViewerFixture bare;
    Input *shown = AddOverlay(bare, TagList{{IO_ShowHandles, false}});
    QVERIFY(bare.Show());
    bare.Hover(bare.At({0.5, 0.5}));
    QCOMPARE(StateOf(bare.OverlayOf(shown), "hoverPart"), 0.0);
    bare.Drag(bare.At({0.5, 0.5}), bare.At({0.5, 0.5}, QPoint(40, 0)), 4);
    QCOMPARE(bare.UndoSteps(), 0);
}

// While its frame is dragged the picture steps aside; at release it is back.
void ImgOverlayControlTest::hiddenWhileDragging()
{
    ViewerFixture f;
    AddOverlay(f, TagList{{IO_HideWhileDragging, true}});
    QVERIFY(f.Show());
    const QPoint at = f.At({0.5, 0.5});
    f.Press(at);
    f.Move(at + QPoint(1, 0));
    QVERIFY(Sides(f).first < 10);
    f.Release(at + QPoint(1, 0));
    QVERIFY(Sides(f).first > 250);
}

QTEST_MAIN(ImgOverlayControlTest)
#include "ImgOverlayControlTest.moc"
