// SPDX-License-Identifier: MIT
#pragma once

#include <array>
#include <optional>

// The Parts Tracker's geometry tests on a line's points, with its limits and its arithmetic.

struct Point {
    double x, y, z;
    bool operator==(const Point&) const = default; // exact, as the Tracker compares
};

// A type 1 line's placement: the 3x3 matrix a..i has a determinant within 1e-11 of zero.
bool IsSingularPlacement(const std::array<double, 12>& numbers);

// The largest corner angle when it is above 179.9 degrees, else the smallest when it is below
// 0.025 degrees; none when the corners are fine. Takes 3 or 4 points.
std::optional<double> ColinearAngle(const Point* points, int count);

// A quad is convex when the normals of its four corners all point the same way.
bool IsConvexQuad(const std::array<Point, 4>& p);

// How far a quad bends, in degrees: the larger angle between the two triangles of either diagonal.
double QuadBend(const std::array<Point, 4>& p);
