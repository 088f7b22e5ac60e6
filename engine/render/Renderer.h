#pragma once

#include "engine/images/Image.h"
#include "engine/render/RenderRequest.h"
#include "engine/render/kernel/RenderSetup.h"
#include "ground/Result.h"

#include <cstdint>
#include <functional>

class KM_Viewport;

namespace quarn {

class DisplayScene;
class RenderLayers;

/// Renders pictures: what Rendered mode draws, with the sun as a disc, and with light that comes
/// from the whole sky and from the surfaces around; curves and points are drawn over it. The same
/// picture comes out every time and for any number of threads, which have ended their work when a
/// call returns.
class Renderer {
public:
    Renderer();
    /// Renders with the loops of a certain kind of processor.
    explicit Renderer(const RenderKernel& kernel) : m_kernel(&kernel) {}

    /// Called between parts of the work, some times a second.
    /// @param share  how much is done, 0 to 1
    /// @return false to end the work here
    using Watch = std::function<bool(double share)>;

    /// Shown the picture so far now and then, which is valid during the call.
    using Shown = std::function<void(const Image& picture)>;

    /// Renders the scene as `viewport` sees it. The camera's opening is fitted to the picture's
    /// aspect, the smaller half angle stays. A camera that is out of range sees the background
    /// alone, see DisplayScene::canBeSeenBy.
    /// @param image  takes the picture; unchanged unless done
    /// @param shown  may be empty; it changes nothing of the picture that comes out in the end
    /// @return an error for a size or number of samples out of range, an invalid camera, and a
    ///         size that there is no memory for
    Result<RenderEnd> render(const DisplayScene& scene, const KM_Viewport& viewport,
                             const RenderRequest& request, const Watch& watch, Image& image,
                             const Shown& shown = {}) const;

    /// Whether a picture of this size can be rendered in so much memory.
    /// @param available  bytes
    static Result<void> checkMemory(const RenderRequest& request, std::uint64_t available);

private:
    const RenderKernel* m_kernel;
};

} // namespace quarn
