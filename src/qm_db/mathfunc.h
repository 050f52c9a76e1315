// Plane geometry.
#pragma once

struct T_POINT2 {
    double x = 0.0;
    double y = 0.0;
};

class CMathFunc {
public:
    /// Crossing of the segments P1-P2 and Q1-Q2, free of scale (a segment may run out to 1e48 and
    /// the axes may differ in unit): tolerances are relative to the segments' own lengths.
    /// `tolerance` is the caller's smallest; never less than 1e-9 is used. A touch within it is a
    /// crossing; segments whose cross product is within it of the sum of its terms are parallel
    /// and do not cross. Returns 1 and fills `param` (0 to 1 along Q) and `point` (on Q, clamped
    /// to it); 0 leaves both as they were.
    static int mathIntersectLine2(const T_POINT2& P1, const T_POINT2& P2, const T_POINT2& Q1,
                                  const T_POINT2& Q2, double tolerance, double& param,
                                  T_POINT2& point);
};
