#pragma once

#include "kelmar/KM_Export.h"
#include "kelmar/KM_Line.h"
#include "kelmar/KM_Point.h"
#include "kelmar/KM_Xform.h"

enum KM_ViewProjection : int {
    KM_parallel_view = 1,
    KM_perspective_view = 2,
};

/// A camera, its frustum and the picture it draws into. A plain value.
///
/// **Camera.** Direction and up are kept as they were set. From them follows the camera frame of
/// unit vectors: X to the right, Y up, and Z from the scene toward the camera, so that the camera
/// looks along -Z.
///
/// **Frustum.** left, right, bottom and top are measured on the near plane in model units, along X
/// and Y; near and far are distances from the camera along the view direction.
///
/// **Screen.** Pixels are counted from the upper left corner of the picture, x to the right and y
/// downward, in continuous coordinates: the picture is [0, width] by [0, height], and the middle of
/// the first pixel is (0.5, 0.5).
class KELMAR_API KM_Viewport {
public:
    /// A perspective camera at (40, -60, 35) that looks at its target, the world origin, with up
    /// along +Z; 50 mm lens; near 0.1, far 1000; screen 800 by 600.
    KM_Viewport();

    // ---- Projection

    bool IsPerspectiveProjection() const { return m_projection == KM_perspective_view; }
    bool IsParallelProjection() const { return m_projection == KM_parallel_view; }
    KM_ViewProjection Projection() const { return m_projection; }
    /// Changes the projection and keeps the size in which things at the target's distance are seen
    /// (at the near plane when there is no target in front of the camera). A near plane that is not
    /// in front of the camera is moved there when the projection becomes perspective. The opening
    /// stays as it is where that size is no number, as for a target 1e308 away.
    /// @return false, with nothing changed, for a value that is no projection
    bool SetProjection(KM_ViewProjection projection);

    // ---- Camera

    /// True when location, direction and up are valid and direction and up are not parallel, so
    /// that the camera frame is theirs.
    bool IsValidCamera() const { return m_frame_is_current && m_location.IsValid(); }

    const KM_3dPoint& CameraLocation() const { return m_location; }
    /// As it was set, with its length.
    const KM_3dVector& CameraDirection() const { return m_direction; }
    /// As it was set; not always perpendicular to the direction.
    const KM_3dVector& CameraUp() const { return m_up; }
    /// The camera frame. While direction and up are parallel it stays the last one that could be
    /// built.
    const KM_3dVector& CameraX() const { return m_x; }
    const KM_3dVector& CameraY() const { return m_y; }
    const KM_3dVector& CameraZ() const { return m_z; }

    /// @return false, with nothing changed, when the point is invalid or the location is locked
    bool SetCameraLocation(const KM_3dPoint& location);
    /// Sets where the camera looks. The frame follows as soon as direction and up allow it: a
    /// direction parallel to the present up is taken, and the frame is built when another up is
    /// set.
    /// @return false, with nothing changed, when the vector is zero or invalid or the direction is
    ///         locked
    bool SetCameraDirection(const KM_3dVector& direction);
    /// Sets which way is up in the picture.
    /// @return false, with nothing changed, when the vector is zero, invalid or parallel to the
    ///         direction (the sine of the angle between them is at most 1e-9), or the up is locked
    bool SetCameraUp(const KM_3dVector& up);

    /// A locked part refuses its setter. All are unlocked at first.
    bool CameraLocationIsLocked() const { return m_location_locked; }
    bool CameraDirectionIsLocked() const { return m_direction_locked; }
    bool CameraUpIsLocked() const { return m_up_locked; }
    void SetCameraLocationLock(bool lock) { m_location_locked = lock; }
    void SetCameraDirectionLock(bool lock) { m_direction_locked = lock; }
    void SetCameraUpLock(bool lock) { m_up_locked = lock; }

    /// The point of interest, about which the camera turns; KM_3dPoint::UnsetPoint when there is
    /// none. It does not move the camera.
    const KM_3dPoint& TargetPoint() const { return m_target; }
    /// Sets the target; the unset point removes it.
    /// @return false, with nothing changed, for any other invalid point
    bool SetTargetPoint(const KM_3dPoint& target);
    /// Distance of the target from the camera, measured along the view direction (negative when it
    /// lies behind); KM_UNSET_VALUE when there is no target or no valid camera.
    double TargetDistance() const;

    // ---- Frustum

    /// Any of the pointers may be null.
    /// @return always true: a viewport has a frustum from the start
    bool GetFrustum(double* left, double* right, double* bottom, double* top, double* near_distance,
                    double* far_distance) const;
    /// @return false, with nothing changed, unless left < right, bottom < top, near < far, all are
    ///         finite, and in perspective near > 0
    bool SetFrustum(double left, double right, double bottom, double top, double near_distance,
                    double far_distance);
    /// Moves the near and far planes and keeps the opening of a perspective frustum.
    /// @return false, with nothing changed, unless near < far, both are finite, and in perspective
    ///         near > 0
    bool SetFrustumNearFar(double near_distance, double far_distance);

    /// Width of the frustum over its height.
    double FrustumAspect() const;
    /// Changes the width or the height about the frustum's middle so that the smaller of the two,
    /// and with it the smaller half angle, stays.
    /// @return false, with nothing changed, unless the aspect is finite and above 0
    bool SetFrustumAspect(double width_over_height);

    /// Half the opening angles of the frustum, in radians: vertical is atan(height / 2 / near).
    /// Either pointer may be null.
    /// @return false, with the angles untouched, in a parallel projection
    bool GetCameraHalfAngles(double* vertical, double* horizontal) const;

    /// Focal length of the lens that gives this opening on a film of 36 mm by 24 mm, where the
    /// 24 mm fill the smaller side of the picture: 12 mm / tan(smaller half angle).
    /// @return false, with `lens_length_mm` untouched, in a parallel projection
    bool GetCamera35mmLensLength(double* lens_length_mm) const;
    /// Opens or narrows the frustum for such a lens and makes it symmetric; the aspect stays.
    /// @return false, with nothing changed, in a parallel projection or when the length is not
    ///         finite and above 0
    bool SetCamera35mmLensLength(double lens_length_mm);

    // ---- Screen

    /// Size of the picture in pixels. Either pointer may be null.
    void GetScreenPort(int* width_px, int* height_px) const;
    /// Sets the size of the picture and gives the frustum its aspect.
    /// @return false, with nothing changed, unless both are above 0
    bool SetScreenPort(int width_px, int height_px);

    // ---- Transforms; all return false, with the result untouched, when the camera is not valid

    /// From camera coordinates (along X, Y, Z, from the camera location) to world coordinates.
    bool GetWorldFromCamera(KM_Xform& world_from_camera) const;
    /// The inverse of GetWorldFromCamera.
    bool GetCameraFromWorld(KM_Xform& camera_from_world) const;
    /// From camera coordinates to the cube [-1, 1]^3: x to the right, y up, z from -1 on the near
    /// plane to 1 on the far plane. Before the perspective division the fourth coordinate is the
    /// distance from the camera along the view direction (1 in a parallel projection).
    bool GetClipFromCamera(KM_Xform& clip_from_camera) const;
    /// From world coordinates to pixels in x and y, and to the cube's z; the fourth coordinate is
    /// as in GetClipFromCamera.
    bool GetScreenFromWorld(KM_Xform& screen_from_world) const;

    /// Where a point is seen.
    /// @param x_px, y_px  receive continuous pixel coordinates, outside the picture too; may be
    /// null
    /// @param depth       receives the distance from the camera along the view direction, in model
    ///                    units; may be null
    /// @return false, with the results untouched, when the camera or the point is not valid, or in
    ///         perspective the point does not lie in front of the camera
    bool WorldToScreen(const KM_3dPoint& point, double* x_px, double* y_px, double* depth) const;

    /// The ray on which everything lies that is seen at a place of the picture.
    /// @param origin     the camera location; in a parallel projection the point of the plane
    ///                   through it that is seen there
    /// @param direction  unit vector into the scene
    /// @return false, with the results untouched, when the camera or a coordinate is not valid
    bool GetRay(double x_px, double y_px, KM_3dPoint& origin, KM_3dVector& direction) const;
    /// The part of that ray between the near and the far plane.
    bool GetRay(double x_px, double y_px, KM_Line& near_to_far) const;

    /// Equal when everything that can be set is equal.
    friend KELMAR_API bool operator==(const KM_Viewport&, const KM_Viewport&) = default;

private:
    bool UpdateFrame();
    void ScaleOpening(double factor);

    KM_ViewProjection m_projection = KM_perspective_view;
    KM_3dPoint m_location{40.0, -60.0, 35.0};
    KM_3dVector m_direction{-40.0, 60.0, -35.0};
    KM_3dVector m_up{0.0, 0.0, 1.0};
    KM_3dPoint m_target{0.0, 0.0, 0.0};
    KM_3dVector m_x;
    KM_3dVector m_y;
    KM_3dVector m_z;
    bool m_frame_is_current = false;
    bool m_location_locked = false;
    bool m_direction_locked = false;
    bool m_up_locked = false;
    double m_left = -0.032;
    double m_right = 0.032;
    double m_bottom = -0.024;
    double m_top = 0.024;
    double m_near = 0.1;
    double m_far = 1000.0;
    int m_width_px = 800;
    int m_height_px = 600;
};
