#include <gtest/gtest.h>

#include "primitives/vel_math_primitive.h"

namespace {
void ExpectPosition(const _VelVertex& v, double x, double y, double z)
{
    EXPECT_EQ(v.position.dimension, 3);
    EXPECT_EQ(v.position.x, x);
    EXPECT_EQ(v.position.y, y);
    EXPECT_EQ(v.position.z, z);
}
}  // namespace

TEST(MakeGrid, TwoDivisionsInterleaveLinesAlongXAndY)
{
    CVelPrimitive p;
    ASSERT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(10, 10), 2, p), 0);
    ASSERT_EQ(p.groups.GetSize(), 1);
    const CVelTrianglePolys& g = p.groups[0];
    EXPECT_EQ(g.GroupType, 1);
    ASSERT_EQ(g.vertices.GetSize(), 12);
    const double expected[12][2] = {{0, 0}, {10, 0}, {0, 0}, {0, 10}, {0, 5}, {10, 5},
                                    {5, 0}, {5, 10}, {0, 10}, {10, 10}, {10, 0}, {10, 10}};
    for (int i = 0; i < 12; ++i)
        ExpectPosition(g.vertices[i], expected[i][0], expected[i][1], 0);
    EXPECT_EQ(g.material.diffuse.r, static_cast<float>(0.8 * static_cast<double>(0.8f)));
    EXPECT_EQ(g.material.ambient.g, 0.8f);
    EXPECT_EQ(g.material.specular.b, 0.2f);
    EXPECT_EQ(g.material.emission.r, 1.0f);
    EXPECT_EQ(g.material.shininess, 70.0f);
    EXPECT_EQ(g.vertices[3].normal.z, 0.0);
}

TEST(MakeGrid, SecondCallAppendsAndReversedCornersCoverTheSameRectangle)
{
    CVelPrimitive p;
    CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(10, 10), 2, p);
    ASSERT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(4, 4), DorVector2(0, 0), 1, p), 1);
    EXPECT_EQ(p.groups[0].vertices.GetSize(), 12);
    ExpectPosition(p.groups[0].vertices[5], 10, 5, 0);
    ASSERT_EQ(p.groups[1].vertices.GetSize(), 8);
    ExpectPosition(p.groups[1].vertices[4], 4, 0, 0);
    ExpectPosition(p.groups[1].vertices[6], 0, 4, 0);
}

TEST(MakeGrid, DivisionsMinusOneGivesAnEmptyGroupZeroAndBelowAreRefused)
{
    CVelPrimitive p;
    EXPECT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(1, 1), -1, p), 0);
    EXPECT_EQ(p.groups[0].vertices.GetSize(), 0);
    EXPECT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(1, 1), 0, p), -1);
    EXPECT_EQ(CVelMathPrimitive::MakeGrid(DorVector2(0, 0), DorVector2(1, 1), -2, p), -1);
    EXPECT_EQ(p.groups.GetSize(), 1);
}

TEST(MakeLine, AppendsTwoVerticesInWhiteEvenWhenEqual)
{
    CVelPrimitive p;
    p.groups.SetSize(2);
    DorVector3 a(1, 2, 3);
    ASSERT_EQ(CVelMathPrimitive::MakeLine(a, a, p), 2);
    const CVelTrianglePolys& g = p.groups[2];
    EXPECT_EQ(g.GroupType, 1);
    ASSERT_EQ(g.vertices.GetSize(), 2);
    ExpectPosition(g.vertices[0], 1, 2, 3);
    ExpectPosition(g.vertices[1], 1, 2, 3);
    EXPECT_EQ(g.material.diffuse.r, 0.8f);
    EXPECT_EQ(g.material.diffuse.a, 1.0f);
    EXPECT_EQ(g.material.ambient.r, 1.0f);
    EXPECT_EQ(p.groups[0].vertices.GetSize(), 0);
}
