#pragma once

#include "kelmar/KM_BinaryArchive.h"
#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"
#include "tests/zoetrix/DialogEntries.h"
#include "tests/zoetrix/PlugInFixture.h"

#include <cstdint>
#include <vector>

/// A document in which curves and points can be put, to be followed by a camera. At first it holds
///   "rail"  a straight curve from (0, 0, 1) to (10, 0, 1), domain [0, 1]
///   "gaze"  a straight curve from (0, 0, 5) to (0, 4, 5), domain [0, 1]
///   "spot"  a point at (1, 2, 3)
///   "nest"  a point at (-4, 0, 2)
///   "slab"  a mesh
class PathFixture : public PlugInFixture {
protected:
    explicit PathFixture(const std::string& plug_ins = "dialogs");

    void SetUp() override;

    /// Puts a curve into the document. @param id  nil makes a new one
    void addCurve(const wchar_t* name, const KM_Curve& curve, const KM_UUID& id = KM_nil_uuid);
    void addPoint(const wchar_t* name, const KM_3dPoint& point);
    /// Puts another curve in the place of the one with this name, with the same id.
    void editCurve(const wchar_t* name, const KM_Curve& curve);
    void remove(const wchar_t* name);

    /// Runs a command at the command line with these answers and Enter to the questions for output.
    CQuarnCommand::result setUpPath(std::wstring_view camera, std::wstring_view target,
                                    std::wstring_view frames);
    CQuarnCommand::result setUpFlythrough(std::wstring_view path, std::wstring_view frames);
    /// Runs a command as a person does who picks these objects and enters this into the dialog.
    CQuarnCommand::result pathInDialog(std::wstring_view camera, std::wstring_view target,
                                       const Entered& entered);
    CQuarnCommand::result flythroughInDialog(std::wstring_view path, const Entered& entered);

    /// That the record still is as SetUp left it.
    void expectRecordUntouched();

private:
    /// Writes an object's geometry: its kind and what belongs to it.
    using Geometry = std::function<void(KM_BinaryArchive&)>;
    void addObject(const wchar_t* name, const KM_UUID& id, const Geometry& write_geometry);

    std::vector<std::uint8_t> m_empty_document; ///< as a file
};

/// A curve of degree 2 with uneven knots, [0, 4]. Its points at 0, 1, 2, 3 and 4 are those of
/// uneven_points: see there.
KM_NurbsCurve unevenCurve();

/// With control points A = (0, 0), B = (4, 0), C = (4, 12), D = (13, 12) and knots 0 0 1 4 4 the
/// second span, from 1 to 4, has at t
///   M = B + (C - B) t / 4, N = C + (D - C) (t - 1) / 3, and the point M + (N - M) (t - 1) / 3:
///   t = 1: M = (4, 3),  N = (4, 12),  the point is M           = (4, 3)
///   t = 2: M = (4, 6),  N = (7, 12),  M + (3, 6) / 3           = (5, 8)
///   t = 3: M = (4, 9),  N = (10, 12), M + (6, 3) 2 / 3         = (8, 11)
///   t = 4: N = D                                               = (13, 12)
/// and the curve begins at A.
inline const KM_3dPointArray uneven_points = {
    {0.0, 0.0, 0.0}, {4.0, 3.0, 0.0}, {5.0, 8.0, 0.0}, {8.0, 11.0, 0.0}, {13.0, 12.0, 0.0}};

/// A curve whose point at k / 4 is (10 k, 0, 0), k = 0..4, but for the piece that begins at
/// `place`, which cannot be evaluated, so that this one place is missing: its inner control points
/// are numbers that documents hold, and the way from one to the other is none any more.
KM_NurbsCurve curveWithHoleAt(int place);
/// A curve that documents hold and that cannot be evaluated anywhere.
KM_NurbsCurve curveWithoutPoints();

testing::AssertionResult near(const KM_3dPointArray& a, const KM_3dPointArray& b, double tolerance);
