#include "convert/vel_shape_to_primitive.h"

#include <functional>
#include <iterator>
#include <limits>

#include "geometry_checks.h"
#include "tests/support/recording_karvel.h"

namespace {
// Two boxes told apart by their walls' shininess: the first makes 6 groups, the second, without
// caps, 4.
class TwoBoxes : public ::testing::Test {
protected:
    void SetUp() override
    {
        first.material.shininess = 1;
        second.material.shininess = 2;
        second.bottomCap = second.topCap = 0;
    }
    CVelPrimitive Convert(std::initializer_list<CDorGeometry*> geometries, CVelPrimitive primitive = CVelPrimitive())
    {
        CDorShape shape;
        for (CDorGeometry* g : geometries)
            shape.Add(g);
        CVelShapeToPrimitive().ConvertShape(shape, primitive);
        return primitive;
    }
    CDorExtruded first = CDorExtruded(Polygon(Square(0, 0, 1)), DorVector3(0, 0, 1));
    CDorExtruded second = CDorExtruded(Polygon(Square(3, 0, 1)), DorVector3(0, 0, 2));
};
}  // namespace

// Groups come in list order, appended, the draw mode kept; null entries, unknown styles, bare
// polygons and a geometry claiming a kind it is not give nothing.
TEST_F(TwoBoxes, GroupsComeInListOrderAndOnlyWhatCannotBeConvertedIsDropped)
{
    CVelPrimitive primitive = Convert({&first, nullptr, &second});
    ASSERT_EQ(primitive.groups.GetSize(), 6 + 4);
    EXPECT_TRUE(primitive.groups[3].material.shininess == 1.0f && primitive.groups[6].material.shininess == 2.0f);
    EXPECT_TRUE(primitive.groups[6].vertices[0].position.x == 3.0 && primitive.DrawMode == 2);
    primitive.DrawMode = 3;
    primitive = Convert({&second}, Convert({&second}, primitive));
    ASSERT_EQ(primitive.groups.GetSize(), 6 + 4 + 8);
    EXPECT_TRUE(primitive.groups[14].vertices[0].position.x == 3.0 && primitive.DrawMode == 3);
    first.SetStyle(5);
    second.SetStyle(DorStyleWire);
    CDorPolygon square(first.bottom), liar(square);
    CDorHolePolygon holed(square);
    liar.kind = DorKindExtruded;
    EXPECT_EQ(Layout(Convert({&first, &square, &holed, &liar, &second}).groups), "L4 L4 L4 L4 S5 S5");
    CVelGroupArray groups;
    CVelShapeToPrimitive().ConvertGeometry(nullptr, groups);
    EXPECT_EQ(groups.GetSize(), 0);
}

// The modeller stores each converted shape as a new entity and reconverts on a change with every
// change flag; ShapeToPrimitive only converts. Any NaN or infinite point or texture vector that an
// extrusion's converter reads makes the whole shape refused: AddShape returns null, ChangeShape and
// ShapeToPrimitive change nothing. Geometries that are not converted are not read.
TEST_F(TwoBoxes, TheModellerStoresReplacesAndRefusesShapes)
{
    const double nan = std::numeric_limits<double>::quiet_NaN(), inf = std::numeric_limits<double>::infinity();
    CDorHoleExtruded holed(HolePolygon(Square(0, 0, 4), {Square(1, 1, 1)}), DorVector3(0, 0, 1));
    CDorPolygon bare = Polygon(Square(0, 0, 1));
    bare.points[0].x = nan;
    CDorShape shape, empty;
    for (CDorGeometry* g : std::initializer_list<CDorGeometry*>{&first, nullptr, &bare, &second, &holed})
        shape.Add(g);
    RecordingKarvel modeller;
    _DorPosition* entity = modeller.AddShape(shape);
    _DorPosition* nothing = modeller.AddShape(empty);
    ASSERT_TRUE(VelShapeIsFinite(shape) && entity && entity != nothing && modeller.entities.count(nothing) == 1u);
    EXPECT_TRUE(modeller.entities[entity].groups.GetSize() == 10 + 10 && modeller.entities[nothing].groups.GetSize() == 0);
    second.top = second.bottom.Translated(DorVector3(0, 0, 7));
    modeller.ChangeShape(entity, shape);
    EXPECT_EQ(modeller.lastChangeFlags, 31);
    EXPECT_EQ(modeller.entities[entity].groups[6].vertices[0].position.z, 7.0);  // the second box's first wall, top first
    CVelPrimitive primitive;
    primitive.groups.SetSize(2);
    modeller.ShapeToPrimitive(shape, primitive);
    EXPECT_TRUE(primitive.groups.GetSize() == 2 + 20 && modeller.entities.size() == 2u);
    const std::function<void()> spoil[] = {
        [&] { first.bottom.points[2].y = nan; }, [&] { second.top.points[0].z = -inf; },
        [&] { first.top.textureOrigin.x = inf; }, [&] { second.textureAxis.z = nan; },
        [&] { holed.top.holes[0].points[3].x = inf; }, [&] { holed.bottom.holeTextureAxis.y = nan; }};
    modeller.lastChangeFlags = 0;
    for (size_t i = 0; i < std::size(spoil); ++i) {
        CDorExtruded firstKept = first, secondKept = second;
        CDorHoleExtruded holedKept = holed;
        spoil[i]();
        primitive.groups.SetSize(0);
        modeller.ShapeToPrimitive(shape, primitive);
        modeller.ChangeShape(entity, shape);
        EXPECT_TRUE(!VelShapeIsFinite(shape) && modeller.AddShape(shape) == nullptr && primitive.groups.GetSize() == 0) << i;
        EXPECT_TRUE(modeller.entities.size() == 2u && modeller.lastChangeFlags == 0) << i;
        first = firstKept, second = secondKept, holed = holedKept;
    }
}
