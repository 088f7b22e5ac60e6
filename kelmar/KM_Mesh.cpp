#include "kelmar/KM_Mesh.h"

#include "kelmar/KM_Xform.h"
#include "kelmar/KM_wString.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

constexpr std::size_t most_elements = std::numeric_limits<int>::max();

bool namesVertices(const KM_MeshTriangle& triangle, std::size_t vertex_count) {
    return triangle.vi[0] < vertex_count && triangle.vi[1] < vertex_count &&
           triangle.vi[2] < vertex_count;
}

template <class Element>
KM_wString firstInvalid(const std::vector<Element>& elements, const wchar_t* what) {
    const auto found = std::find_if(elements.begin(), elements.end(),
                                    [](const Element& element) { return !element.IsValid(); });
    if (found == elements.end())
        return {};
    return KM_wString::FormatToString(L"%s %d is not finite.", what,
                                      static_cast<int>(found - elements.begin()));
}

KM_wString countMismatch(std::size_t count, std::size_t vertex_count, const wchar_t* what) {
    if (count == 0 || count == vertex_count)
        return {};
    return KM_wString::FormatToString(L"There are %zu %s for %zu vertices.", count, what,
                                      vertex_count);
}

KM_wString firstBadIndex(const KM_Mesh& mesh) {
    for (std::size_t face = 0; face < mesh.m_F.size(); ++face) {
        for (const std::uint32_t index : mesh.m_F[face].vi) {
            if (index >= mesh.m_V.size())
                return KM_wString::FormatToString(
                    L"Triangle %zu names vertex %u, but there are %zu vertices.", face, index,
                    mesh.m_V.size());
        }
    }
    return {};
}

KM_wString whatIsWrong(const KM_Mesh& mesh) {
    if (mesh.m_F.empty())
        return L"The mesh has no triangles.";
    if (mesh.m_V.size() > most_elements || mesh.m_F.size() > most_elements)
        return L"The mesh has too many vertices or triangles.";
    const std::size_t vertices = mesh.m_V.size();
    for (const KM_wString& problem :
         {firstBadIndex(mesh), firstInvalid(mesh.m_V, L"Vertex"),
          countMismatch(mesh.m_N.size(), vertices, L"normals"), firstInvalid(mesh.m_N, L"Normal"),
          countMismatch(mesh.m_T.size(), vertices, L"texture coordinates"),
          firstInvalid(mesh.m_T, L"Texture coordinate"),
          countMismatch(mesh.m_C.size(), vertices, L"colors")}) {
        if (!problem.IsEmpty())
            return problem;
    }
    return {};
}

void addAngleWeightedNormal(const KM_Mesh& mesh, const KM_MeshTriangle& triangle,
                            std::vector<KM_3dVector>& sums) {
    KM_3dPoint corners[3];
    for (int i = 0; i < 3; ++i)
        corners[i] = mesh.m_V[triangle.vi[i]].ToDouble();
    KM_3dVector normal = KM_CrossProduct(corners[1] - corners[0], corners[2] - corners[0]);
    if (!normal.Unitize())
        return;
    for (int i = 0; i < 3; ++i) {
        const KM_3dVector a = corners[(i + 1) % 3] - corners[i];
        const KM_3dVector b = corners[(i + 2) % 3] - corners[i];
        const double angle = std::atan2(KM_CrossProduct(a, b).Length(), a * b);
        sums[triangle.vi[i]] += angle * normal;
    }
}

template <class Element>
void appendOptional(std::vector<Element>& to, const std::vector<Element>& added,
                    std::size_t to_count, std::size_t added_count) {
    if (to.size() == to_count && added.size() == added_count)
        to.insert(to.end(), added.begin(), added.end());
    else
        to.clear();
}

void makeNormalsComplete(KM_Mesh& mesh) {
    if (mesh.m_N.size() != mesh.m_V.size())
        mesh.ComputeVertexNormals();
}

} // namespace

bool KM_Mesh::IsValid(KM_wString* why) const {
    const KM_wString problem = whatIsWrong(*this);
    if (why)
        *why = problem;
    return problem.IsEmpty();
}

KM_BoundingBox KM_Mesh::BoundingBox() const {
    constexpr float largest = std::numeric_limits<float>::max();
    KM_3fPoint min(largest, largest, largest);
    KM_3fPoint max(-largest, -largest, -largest);
    bool is_empty = true;
    for (const KM_3fPoint& vertex : m_V) {
        if (!vertex.IsValid())
            continue;
        is_empty = false;
        min = {std::min(min.x, vertex.x), std::min(min.y, vertex.y), std::min(min.z, vertex.z)};
        max = {std::max(max.x, vertex.x), std::max(max.y, vertex.y), std::max(max.z, vertex.z)};
    }
    return is_empty ? KM_BoundingBox() : KM_BoundingBox(min.ToDouble(), max.ToDouble());
}

void KM_Mesh::ComputeVertexNormals() {
    std::vector<KM_3dVector> sums(m_V.size());
    for (const KM_MeshTriangle& triangle : m_F) {
        if (namesVertices(triangle, m_V.size()))
            addAngleWeightedNormal(*this, triangle, sums);
    }
    m_N.clear();
    m_N.reserve(sums.size());
    for (KM_3dVector& sum : sums)
        m_N.emplace_back(sum.Unitize() ? sum : KM_3dVector::ZAxis);
}

bool KM_Mesh::Transform(const KM_Xform& xform) {
    KM_Xform inverse = xform;
    if (!inverse.Invert())
        return false;
    std::vector<KM_3fPoint> vertices;
    vertices.reserve(m_V.capacity());
    for (const KM_3fPoint& vertex : m_V) {
        vertices.emplace_back(xform * vertex.ToDouble());
        if (!vertices.back().IsValid())
            return false;
    }
    m_V = std::move(vertices);

    const bool mirrors = xform.Determinant() < 0.0;
    // Normals are planes' directions: the transposed inverse keeps them perpendicular.
    inverse.Transpose();
    for (KM_3fVector& normal : m_N) {
        KM_3dVector turned = inverse * normal.ToDouble();
        if (turned.Unitize())
            normal = KM_3fVector(turned);
    }
    if (mirrors) {
        for (KM_MeshTriangle& triangle : m_F)
            std::swap(triangle.vi[1], triangle.vi[2]);
    }
    return true;
}

bool KM_Mesh::Append(const KM_Mesh& other) {
    if (m_V.size() + other.m_V.size() > most_elements ||
        m_F.size() + other.m_F.size() > most_elements)
        return false;
    KM_Mesh added = other; // a copy, because `other` may be this mesh
    if (m_V.empty() && m_F.empty()) {
        *this = std::move(added);
        return true;
    }
    if (!m_N.empty() || !added.m_N.empty()) {
        makeNormalsComplete(*this);
        makeNormalsComplete(added);
    }
    if (!m_C.empty() || !added.m_C.empty()) {
        m_C.resize(m_V.size(), KM_Color{255, 255, 255, 255});
        added.m_C.resize(added.m_V.size(), KM_Color{255, 255, 255, 255});
    }
    const std::size_t count = m_V.size();
    const std::size_t added_count = added.m_V.size();
    appendOptional(m_N, added.m_N, count, added_count);
    appendOptional(m_T, added.m_T, count, added_count);
    appendOptional(m_C, added.m_C, count, added_count);
    m_V.insert(m_V.end(), added.m_V.begin(), added.m_V.end());
    for (KM_MeshTriangle triangle : added.m_F) {
        for (std::uint32_t& index : triangle.vi)
            index += static_cast<std::uint32_t>(count);
        m_F.push_back(triangle);
    }
    return true;
}

void KM_Mesh::Clear() {
    *this = KM_Mesh();
}

void KM_Mesh::PadForRayTracing() {
    m_V.reserve(m_V.size() + 1);
}
