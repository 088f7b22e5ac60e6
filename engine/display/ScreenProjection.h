#pragma once

namespace quarn {

struct CameraRays;

/// A place of the picture and how near it is, in the measure of DepthImage.
struct ScreenPoint {
    float x = 0.0F; ///< continuous pixels
    float y = 0.0F;
    float nearness = 0.0F;
    float strength = 1.0F; ///< how clearly a line is drawn here, 0 to 1
    float growth = 1.0F;   ///< how far it grows to an outline's width, 0 to 1
};

/// A straight piece of a line on the screen.
struct ScreenSegment {
    ScreenPoint from;
    ScreenPoint to;
};

/// Carries points of the world to where the camera's rays see them.
class ScreenProjection {
public:
    /// @param width, height  of the picture, in pixels
    /// @param margin_px      how far beyond the picture segments are still kept
    ScreenProjection(const CameraRays& rays, int width, int height, float margin_px);

    /// Projects the segment between two points of the world and clips it: in perspective to what
    /// lies before the camera, and to the picture with its margin.
    /// @return false when nothing of it is left or a coordinate is not finite
    bool project(const double (&from)[3], const double (&to)[3], ScreenSegment& segment) const;

    /// Projects a point of the world.
    /// @return false when it lies behind the camera or outside the picture
    bool project(const double (&world)[3], ScreenPoint& point) const;
    /// How near a point of the world is, in the measure of DepthImage; 0 behind the camera.
    float nearness(const double (&world)[3]) const;

private:
    struct CameraPoint {
        double x;
        double y;
        double depth;
    };
    /// As a ScreenPoint, of any size: single precision does not reach to where lines near the
    /// camera leave the picture.
    struct PicturePoint {
        double x;
        double y;
        double nearness;
    };
    CameraPoint cameraPoint(const double (&world)[3]) const;
    PicturePoint picturePoint(const CameraPoint& p) const;
    bool clipToPicture(const PicturePoint& a, const PicturePoint& b, ScreenSegment& segment) const;
    ScreenPoint within(const PicturePoint& p) const;

    double m_eye[3];
    double m_x[3];
    double m_y[3];
    double m_z[3];
    double m_left;
    double m_top;
    double m_pixels_per_x;
    double m_pixels_per_y;
    double m_near;
    double m_far;
    bool m_parallel;
    double m_min;
    double m_max_x;
    double m_max_y;
    double m_width;
    double m_height;
};

} // namespace quarn
