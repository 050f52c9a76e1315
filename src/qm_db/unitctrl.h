// Current units of a document: conversion of lengths and other quantities in and out.
#pragma once

#include "qm_db/datactrl.h"

class CUnitCtrl {
public:
    explicit CUnitCtrl(const CDataCtrl& data) : m_data(data) {}

    T_UNITS Units() const { return m_data.Units(); }
    double ConvertUnitLengthIn(double value) const { return In(value, kDimLength); }
    double ConvertUnitLengthOut(double value) const { return Out(value, kDimLength); }
    /// Current units to SI, and back.
    double In(double value, T_DIM dim) const { return ToSi(value, m_data.Units(), dim); }
    double Out(double value, T_DIM dim) const { return FromSi(value, m_data.Units(), dim); }

private:
    const CDataCtrl& m_data;
};
