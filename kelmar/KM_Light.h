#pragma once

#include "kelmar/KM_Color.h"
#include "kelmar/KM_Export.h"
#include "kelmar/KM_Point.h"
#include "kelmar/KM_Uuid.h"
#include "kelmar/KM_wString.h"

/// What kind of light it is and in which coordinates it is placed: those of the camera, so that it
/// moves with it, or those of the world. Documents store the values.
enum class KM_LightStyle : int {
    unknown = 0,
    camera_directional = 4,
    camera_point = 5,
    camera_spot = 6,
    world_directional = 7,
    world_point = 8,
    world_spot = 9,
    ambient = 10,
};

/// A light of the document. A plain value.
class KELMAR_API KM_Light {
public:
    /// Sets the style by value; a value that no style has sets `unknown`.
    void SetStyle(int style);
    void SetStyle(KM_LightStyle style) { m_style = style; }
    /// Default: unknown.
    KM_LightStyle Style() const { return m_style; }
    /// True for the two styles that shine everywhere in the same direction, as the sun does.
    bool IsDirectionalLight() const;

    /// Where the light stands, in model units. A directional light shines from there only in that
    /// its symbol is drawn there. Default: the world origin.
    void SetLocation(const KM_3dPoint& location) { m_location = location; }
    const KM_3dPoint& Location() const { return m_location; }

    /// Where the light shines to, with any length, which is kept. Default: (0, 0, -1).
    void SetDirection(const KM_3dVector& direction) { m_direction = direction; }
    const KM_3dVector& Direction() const { return m_direction; }

    /// A factor of the colour: 0 dark, 1 full. A negative or invalid one counts as 0. Default: 1.
    void SetIntensity(double intensity);
    double Intensity() const { return m_intensity; }

    /// How dark the light's shadows are: 0 none, 1 full. Moved into [0, 1]; an invalid number
    /// counts as 0. Default: 1.
    void SetShadowIntensity(double intensity);
    double ShadowIntensity() const { return m_shadow_intensity; }

    /// Default: white.
    void SetDiffuse(const KM_Color& color) { m_diffuse = color; }
    const KM_Color& Diffuse() const { return m_diffuse; }

    /// Switches the light on or off. Default: on.
    void Enable(bool on = true) { m_enabled = on; }
    bool IsEnabled() const { return m_enabled; }

    /// Default: nil.
    void SetLightId(const KM_UUID& id) { m_id = id; }
    const KM_UUID& LightId() const { return m_id; }
    /// Default: empty.
    void SetLightName(const KM_wString& name) { m_name = name; }
    const KM_wString& LightName() const { return m_name; }

    friend KELMAR_API bool operator==(const KM_Light&, const KM_Light&) = default;

private:
    KM_LightStyle m_style = KM_LightStyle::unknown;
    KM_3dPoint m_location;
    KM_3dVector m_direction{0.0, 0.0, -1.0};
    double m_intensity = 1.0;
    double m_shadow_intensity = 1.0;
    KM_Color m_diffuse{255, 255, 255, 255};
    bool m_enabled = true;
    KM_UUID m_id;
    KM_wString m_name;
};
