// Tolerant comparison.
#pragma once

class CCompFunc {
public:
    /// -1, 0 or 1 for a < b, a equal b within |a - b| <= tolerance, a > b.
    static int CompRealTol(double a, double b, double tolerance)
    {
        const double diff = a - b;
        if ((diff < 0.0 ? -diff : diff) <= tolerance) return 0;
        return diff < 0.0 ? -1 : 1;
    }
};
