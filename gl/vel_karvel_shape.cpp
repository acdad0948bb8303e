// The modeller's shape entry points: conversion followed by the entity store's own operations.
#include "gl/vel_karvel.h"

#include "convert/vel_shape_to_primitive.h"
#include "gl/vel_misuse.h"

namespace {
// A shape with a non-finite coordinate is refused before conversion, whatever it would make.
bool Convertible(const CDorShape& shape)
{
    if (VelShapeIsFinite(shape))
        return true;
    VelReportMisuse("a shape with a non-finite coordinate, refused");
    return false;
}

void Convert(const CDorShape& shape, CVelPrimitive& primitive)
{
    CVelShapeToPrimitive converter;
    converter.ConvertShape(shape, primitive);
}
}  // namespace

_DorPosition* CVelKarvel::AddShape(CDorShape& shape)
{
    if (!Convertible(shape))
        return nullptr;
    CVelPrimitive primitive;
    Convert(shape, primitive);
    return AddPrimitive(primitive);
}

void CVelKarvel::ChangeShape(_DorPosition* position, CDorShape& shape)
{
    if (!Convertible(shape))
        return;
    CVelPrimitive primitive;
    Convert(shape, primitive);
    ChangePrimitive(position, primitive, 31);
}

void CVelKarvel::ShapeToPrimitive(const CDorShape& shape, CVelPrimitive& primitive)
{
    if (Convertible(shape))
        Convert(shape, primitive);
}
