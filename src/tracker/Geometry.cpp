// SPDX-License-Identifier: MIT
#include "Geometry.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

Point operator-(const Point& a, const Point& b) { return {a.x - b.x, a.y - b.y, a.z - b.z}; }
double dot(const Point& a, const Point& b) { return a.x * b.x + a.y * b.y + a.z * b.z; }
double length(const Point& a) { return std::sqrt(dot(a, a)); }
Point cross(const Point& a, const Point& b)
{
    return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}
Point unit(const Point& a)
{
    const auto l = length(a);
    return {a.x / l, a.y / l, a.z / l};
}
// The normal of triangle a b c as the Tracker orients it.
Point triangleNormal(const Point& a, const Point& b, const Point& c) { return unit(cross(a - b, c - a)); }

// The cosine of the angle between u and v in the Tracker's own arithmetic (1 - (1 - cos) rounds
// differently from cos alone), clamped into [-1, 1] so that exactly colinear points give 0 or
// 180 degrees rather than no angle.
double cosineBetween(const Point& u, const Point& v)
{
    return std::clamp(1 - (1 - dot(u, v) / (length(u) * length(v))), -1.0, 1.0);
}

double degreesOf(double cosine) { return std::acos(cosine) * 180 / std::numbers::pi; }

} // namespace

bool IsSingularPlacement(const std::array<double, 12>& m)
{
    // x y z a b c d e f g h i
    const double a = m[3], b = m[4], c = m[5], d = m[6], e = m[7], f = m[8], g = m[9], h = m[10], i = m[11];
    const double determinant = a * (e * i - f * h) - b * (d * i - f * g) + c * (d * h - e * g);
    return std::abs(determinant) <= 1e-11;
}

std::optional<double> ColinearAngle(const Point* p, int count)
{
    // The largest angle has the smallest cosine: only the two extremes need their angle, and
    // only when their cosines come near the limits (cos 179.9 and cos 0.025 degrees).
    constexpr double NearlyStraight = -0.9999984769, NearlyFolded = 0.9999999048;
    double smallestCosine = 1, largestCosine = -1;
    for (int k = 0; k < count; ++k) {
        const auto& corner = p[(k + 1) % count];
        const auto cosine = cosineBetween(p[k] - corner, p[(k + 2) % count] - corner);
        smallestCosine = std::min(smallestCosine, cosine);
        largestCosine = std::max(largestCosine, cosine);
    }
    if (smallestCosine > NearlyStraight + 1e-9 && largestCosine < NearlyFolded - 1e-9)
        return std::nullopt;
    if (const auto largest = degreesOf(smallestCosine); largest > 179.9)
        return largest;
    if (const auto smallest = degreesOf(largestCosine); smallest < 0.025)
        return smallest;
    return std::nullopt;
}

bool IsConvexQuad(const std::array<Point, 4>& p)
{
    const Point edges[4] = {p[1] - p[0], p[2] - p[1], p[3] - p[2], p[0] - p[3]};
    Point normals[4];
    for (int k = 0; k < 4; ++k)
        normals[k] = unit(cross(edges[k], edges[(k + 1) % 4]));
    for (int k = 0; k < 4; ++k)
        if (!(dot(normals[k], normals[(k + 1) % 4]) > 0))
            return false;
    return true;
}

double QuadBend(const std::array<Point, 4>& p)
{
    const auto alongTwoFour = cosineBetween(triangleNormal(p[0], p[1], p[3]), triangleNormal(p[1], p[2], p[3]));
    const auto alongOneThree = cosineBetween(triangleNormal(p[0], p[2], p[3]), triangleNormal(p[0], p[1], p[2]));
    return degreesOf(std::min(alongTwoFour, alongOneThree)); // the larger angle has the smaller cosine
}
