#pragma once

#include "engine/display/kernel/RayPacket.h"

namespace quarn {
namespace {

/// The surfaces along the rays of a packet, the nearest few of which are found together: looking
/// for one after the other would send the rays through the whole scene for each layer.
class LayerHits {
public:
    /// Looks for what the rays of `packet.active` meet.
    LayerHits(const FrameSetup& frame, RayPacket& packet) {
        rtcInitIntersectContext(&m_call.context);
        m_call.context.flags = RTC_INTERSECT_CONTEXT_FLAG_COHERENT;
        m_call.context.filter = keepHits;
        m_call.hits = this;
        store(m_known, Lanes(unlimited));
        store(m_count, LaneInts(0));
        find(frame, packet, packet.active, 0.0F);
    }

    /// Lets the rays of `packet.active` meet the nearest surface that is farther than `beyond`.
    void next(const FrameSetup& frame, RayPacket& packet, const Lanes& beyond) {
        for (;;) {
            choose(packet, beyond);
            const LaneMask unknown =
                packet.active & ~packet.hit & (load(m_known) < Lanes(unlimited));
            if (!any(unknown))
                return;
            forget(unknown);
            find(frame, packet, unknown, beyond);
        }
    }

private:
    /// How many surfaces of a ray are kept at a time.
    static constexpr unsigned capacity = 8;
    static constexpr float nowhere = 2.0F * unlimited;
    /// In the order in which the ray tracer hands them over.
    enum Field { normal_x, normal_y, normal_z, u, v, primitive, geometry, instance, field_count };

    struct Call {
        RTCIntersectContext context; ///< first: rays are shot with its address
        LayerHits* hits;
    };

    void forget(const LaneMask& lanes) {
        for (unsigned k = 0; k < m_slots; ++k)
            store(m_distance[k], select(lanes, Lanes(nowhere), load(m_distance[k])));
        store(m_known, select(lanes, Lanes(unlimited), load(m_known)));
        store(m_count, select(lanes, LaneInts(0), load(m_count)));
    }

    void find(const FrameSetup& frame, RayPacket& packet, const LaneMask& lanes,
              const Lanes& beyond) {
        RTCRayHit16& rays = packet.rays;
        store(rays.ray.tnear, select(lanes, beyond, 0.0F));
        store(rays.ray.tfar, select(lanes, unlimited, no_distance));
        store(rays.ray.id, laneNumbers());
        if (frame.scene)
            rtcIntersect16(lanes.data(), frame.scene, &m_call.context, &rays);
        store(rays.ray.tnear, 0.0F);
    }

    static void keepHits(const RTCFilterFunctionNArguments* arguments) {
        LayerHits& hits = *reinterpret_cast<Call*>(arguments->context)->hits;
        for (unsigned wanted = wantedOf(*arguments); wanted != 0; wanted &= wanted - 1) {
            const auto i = static_cast<unsigned>(__builtin_ctz(wanted));
            arguments->valid[i] = hits.keep(*arguments, i) ? 0 : -1;
        }
    }

    /// A bit for each ray of the call that met something; mostly few of them.
    static unsigned wantedOf(const RTCFilterFunctionNArguments& arguments) {
        if (arguments.N == lane_count) {
            LaneMask valid;
            __builtin_memcpy(&valid, arguments.valid, sizeof valid);
            return bits(valid);
        }
        unsigned wanted = 0;
        for (unsigned i = 0; i < arguments.N; ++i)
            wanted |= arguments.valid[i] != 0 ? 1U << i : 0U;
        return wanted;
    }

    /// @return false when nothing behind this hit will be kept: then it ends the ray
    bool keep(const RTCFilterFunctionNArguments& arguments, unsigned index) {
        const unsigned lane = RTCRayN_id(arguments.ray, arguments.N, index);
        const float distance = RTCRayN_tfar(arguments.ray, arguments.N, index);
        unsigned slot = m_count[lane];
        if (slot < capacity) {
            if (slot == m_slots)
                store(m_distance[m_slots++], Lanes(nowhere));
            ++m_count[lane];
        } else {
            slot = farthest(lane);
            const float dropped = m_distance[slot][lane];
            if (distance >= dropped) {
                m_known[lane] = distance < m_known[lane] ? distance : m_known[lane];
                return false;
            }
            m_known[lane] = dropped;
        }
        m_distance[slot][lane] = distance;
        const auto* const fields = reinterpret_cast<const std::uint32_t*>(arguments.hit);
        for (unsigned f = 0; f < field_count; ++f)
            m_fields[f][slot][lane] = fields[f * arguments.N + index];
        return true;
    }

    unsigned farthest(unsigned lane) const {
        unsigned slot = 0;
        for (unsigned k = 1; k < capacity; ++k)
            if (m_distance[k][lane] > m_distance[slot][lane])
                slot = k;
        return slot;
    }

    void choose(RayPacket& packet, const Lanes& beyond) const {
        Lanes nearest = load(m_known);
        LaneInts slot(-1);
        for (unsigned k = 0; k < m_slots; ++k) {
            const Lanes distance = load(m_distance[k]);
            const LaneMask nearer = (distance > beyond) & ~(distance > nearest);
            nearest = select(nearer, distance, nearest);
            slot = select(nearer, LaneInts(static_cast<std::int32_t>(k)), slot);
        }
        packet.hit = packet.active & (slot > LaneInts(-1));
        packet.distance = nearest;
        store(packet.rays.ray.tfar, nearest);
        const LaneInts first = select(packet.hit, slot * LaneInts(lane_count), LaneInts(0));
        take(packet.rays.hit, first + laneNumbers());
    }

    /// @param from  of each lane the place in a field
    void take(RTCHit16& hit, const LaneInts& from) const {
        const auto kept = [&](Field field) { return gathered(m_fields[field][0], from); };
        store(hit.Ng_x, floatsWith(kept(normal_x)));
        store(hit.Ng_y, floatsWith(kept(normal_y)));
        store(hit.Ng_z, floatsWith(kept(normal_z)));
        store(hit.u, floatsWith(kept(u)));
        store(hit.v, floatsWith(kept(v)));
        store(hit.primID, kept(primitive));
        store(hit.geomID, kept(geometry));
        store(hit.instID[0], kept(instance));
    }

    Call m_call;
    unsigned m_slots = 0;                  ///< how many are in use, by the ray that uses most
    alignas(64) float m_known[lane_count]; ///< every surface that is nearer is kept
    alignas(64) std::uint32_t m_count[lane_count];
    alignas(64) float m_distance[capacity][lane_count];
    alignas(64) std::uint32_t m_fields[field_count][capacity][lane_count];
};

} // namespace
} // namespace quarn
