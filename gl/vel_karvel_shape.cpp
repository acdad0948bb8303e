// The modeller's shape entry points: conversion followed by the entity store's own operations.
#include "gl/vel_karvel.h"

#include "convert/vel_shape_to_primitive.h"

_DorPosition* CVelKarvel::AddShape(CDorShape& shape)
{
    CVelPrimitive primitive;
    ShapeToPrimitive(shape, primitive);
    return AddPrimitive(primitive);
}

void CVelKarvel::ChangeShape(_DorPosition* position, CDorShape& shape)
{
    CVelPrimitive primitive;
    ShapeToPrimitive(shape, primitive);
    ChangePrimitive(position, primitive, 31);
}

void CVelKarvel::ShapeToPrimitive(const CDorShape& shape, CVelPrimitive& primitive)
{
    CVelShapeToPrimitive converter;
    converter.ConvertShape(shape, primitive);
}
