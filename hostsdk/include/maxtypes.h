#pragma once

// Basic types of the host SDK: times and intervals, class and interface ids, points and colors,
// strings. A stand-in with the SDK's names, holding only what the plug-in uses.

#include <cstdint>
#include <string>

#include "WinTypes.h"

// What libpigmo-hostsdk.so exports to plug-ins and host tools.
#define HostExport __attribute__((visibility("default")))

using MCHAR = char;
using TimeValue = int;
using SClass_ID = ULONG;
using PartID = ULONG;
using RefMessage = unsigned int;
using BlockID = short;
using ParamID = short;
using StringResID = int;

inline constexpr TimeValue TIME_NegInfinity = static_cast<TimeValue>(0x80000000);
inline constexpr TimeValue TIME_PosInfinity = 0x7fffffff;
inline constexpr SClass_ID TEXMAP_CLASS_ID = 0xC10;

// A range of time, both ends included; empty when it starts at negative infinity and ends there.
class HostExport Interval {
public:
    Interval() : start_(TIME_NegInfinity), end_(TIME_NegInfinity) {}
    Interval(TimeValue start, TimeValue end) : start_(start), end_(end) {}

    void SetInfinite() { *this = Interval(TIME_NegInfinity, TIME_PosInfinity); }
    void SetEmpty() { *this = Interval(); }
    bool Empty() const { return start_ == TIME_NegInfinity && end_ == TIME_NegInfinity; }
    BOOL InInterval(TimeValue t) const { return !Empty() && t >= start_ && t <= end_ ? TRUE : FALSE; }
    TimeValue Start() const { return start_; }
    TimeValue End() const { return end_; }
    bool operator==(const Interval& other) const = default;
    // Intersection.
    Interval& operator&=(const Interval& other);

private:
    TimeValue start_;
    TimeValue end_;
};

inline const Interval FOREVER(TIME_NegInfinity, TIME_PosInfinity);
inline const Interval NEVER;

class Class_ID {
public:
    constexpr Class_ID() = default;
    constexpr Class_ID(ULONG a, ULONG b) : a_(a), b_(b) {}
    constexpr ULONG PartA() const { return a_; }
    constexpr ULONG PartB() const { return b_; }
    constexpr bool operator==(const Class_ID& other) const = default;

private:
    ULONG a_ = 0xFFFFFFFF;
    ULONG b_ = 0xFFFFFFFF;
};

class Interface_ID {
public:
    constexpr Interface_ID() = default;
    constexpr Interface_ID(ULONG a, ULONG b) : a_(a), b_(b) {}
    constexpr ULONG PartA() const { return a_; }
    constexpr ULONG PartB() const { return b_; }
    constexpr bool operator==(const Interface_ID& other) const = default;

private:
    ULONG a_ = 0;
    ULONG b_ = 0;
};

struct Point3 {
    float x = 0, y = 0, z = 0;
    constexpr Point3() = default;
    constexpr Point3(float x_, float y_, float z_) : x(x_), y(y_), z(z_) {}
    constexpr Point3(double x_, double y_, double z_)
        : x(static_cast<float>(x_)), y(static_cast<float>(y_)), z(static_cast<float>(z_)) {}
    constexpr bool operator==(const Point3& other) const = default;
};

struct Color {
    float r = 0, g = 0, b = 0;
    constexpr Color() = default;
    constexpr Color(float r_, float g_, float b_) : r(r_), g(g_), b(b_) {}
    constexpr explicit Color(const Point3& p) : r(p.x), g(p.y), b(p.z) {}
    constexpr bool operator==(const Color& other) const = default;
};

struct AColor {
    float r = 0, g = 0, b = 0, a = 0;
    constexpr AColor() = default;
    constexpr AColor(float r_, float g_, float b_, float a_ = 1.0f) : r(r_), g(g_), b(b_), a(a_) {}
    constexpr bool operator==(const AColor& other) const = default;
};

// A 4 x 3 transform, rows of x, y, z and translation.
class HostExport Matrix3 {
public:
    Matrix3() { IdentityMatrix(); }
    void IdentityMatrix();
    bool IsIdentity() const;
    const float* GetRow(int i) const { return rows_[i]; }

private:
    float rows_[4][3];
};

// The SDK's string: an owned 8-bit text.
class CStr {
public:
    CStr() = default;
    CStr(const char* text) : text_(text != nullptr ? text : "") {}
    CStr(std::string text) : text_(std::move(text)) {}
    const char* data() const { return text_.c_str(); }
    operator const char*() const { return text_.c_str(); }
    int Length() const { return static_cast<int>(text_.size()); }
    bool operator==(const CStr& other) const = default;

private:
    std::string text_;
};
using MSTR = CStr;
