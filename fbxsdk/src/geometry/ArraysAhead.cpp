// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The result of a request does not depend on who inflates the array, errors included: an array that could not be
// inflated in advance, for lack of memory or because the file was changed, is inflated again by the thread that
// requests it.
#include "geometry/ArraysAhead.h"

#include <algorithm>
#include <functional>
#include <iterator>
#include <string_view>
#include <utility>

#include <fbxsdk/extensions/Threads.h>

#include "geometry/ItemReading.h"
#include "schema/LayerElements.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// Less does not justify a thread.
constexpr std::size_t kLeastBytes = std::size_t{1} << 20;
/// How much may be inflated before it is requested, per thread, and one array more.
constexpr std::size_t kMostReadyBytes = std::size_t{1} << 22;
constexpr std::size_t kMostMeshes = 1024;

std::size_t sizeOf(const StoredArray* array) {
    return static_cast<std::size_t>(array->count) * elementSize(array->element);
}

class ArrayList {
public:
    explicit ArrayList(const FileBytes& file) : mFile(file) {}

    /// The largest one first, so that it is not started last.
    void addMesh(const Record& body) {
        if (!body.child("PolygonVertexIndex")) // a shape or a surface
            return;
        const std::size_t first = mArrays.size();
        add<double>(body.child("Vertices"));
        for (const LayerElementRow& row : kLayerElements)
            if (row.type == LayerElementType::normal || row.type == LayerElementType::color)
                addElement(body, row);
        addElement(body, coordinatesRow(*std::begin(kLayerChannels)));
        std::stable_sort(mArrays.begin() + static_cast<std::ptrdiff_t>(first), mArrays.end(),
                         [](const StoredArray* a, const StoredArray* b) { return sizeOf(a) > sizeOf(b); });
    }

    [[nodiscard]] std::size_t bytes() const { return mBytes; }
    [[nodiscard]] std::vector<const StoredArray*> take() { return std::move(mArrays); }

private:
    /// The values of all these elements consist of doubles.
    void addElement(const Record& body, const LayerElementRow& row) {
        if (const Record* const element = body.child(row.record)) {
            add<double>(element->child(row.direct));
            add<int>(element->child(row.index));
        }
    }

    template <class Item>
    void add(const Record* record) {
        const StoredArray* const array = record ? record->array() : nullptr;
        if (array && array->compressed && holdsLargeItems<Item>(*array) && mFile.contains(array->bytes)) {
            mArrays.push_back(array);
            mBytes += sizeOf(array);
        }
    }

    const FileBytes& mFile;
    std::vector<const StoredArray*> mArrays;
    std::size_t mBytes = 0;
};

std::vector<std::size_t> sizesOf(const std::vector<const StoredArray*>& arrays) {
    std::vector<std::size_t> sizes(arrays.size());
    std::transform(arrays.begin(), arrays.end(), sizes.begin(), sizeOf);
    return sizes;
}

std::unordered_map<const StoredArray*, std::size_t> placesOf(const std::vector<const StoredArray*>& arrays) {
    std::unordered_map<const StoredArray*, std::size_t> places;
    for (std::size_t i = 0; i < arrays.size(); ++i)
        places.emplace(arrays[i], i);
    return places;
}

const Record* nextMesh(const Record& body) {
    const Record* next = body.nextSibling;
    while (next && next->name != body.name)
        next = next->nextSibling;
    return next;
}

/// The arrays that were requested with an earlier mesh.
struct MeshesAhead final : DocumentCompanion {
    const Record* last = nullptr; ///< the mesh that was read last
    std::vector<const Record*> meshes;
    std::shared_ptr<ArraysAhead> arrays;
};

MeshesAhead& meshesAhead(const Document& document) {
    if (!document.companion)
        document.companion = std::make_unique<MeshesAhead>();
    return static_cast<MeshesAhead&>(*document.companion);
}

} // namespace

std::shared_ptr<ArraysAhead> ArraysAhead::ofMesh(const Record& body, const Document& document) {
    const std::shared_ptr<const FileBytes>& file = document.tree->file;
    if (extensions::maximumThreads() == 1 || !file)
        return nullptr;
    MeshesAhead& ahead = meshesAhead(document);
    const Record* const last = std::exchange(ahead.last, &body);
    if (std::binary_search(ahead.meshes.begin(), ahead.meshes.end(), &body, std::less<>()))
        return ahead.arrays;
    ahead.arrays.reset(); // whoever still waits for some of them holds them
    ahead.meshes.clear();
    ArrayList arrays(*file);
    const std::size_t count = last && nextMesh(*last) == &body ? kMostMeshes : 1;
    for (const Record* mesh = &body; mesh && ahead.meshes.size() < count; mesh = nextMesh(*mesh)) {
        arrays.addMesh(*mesh);
        ahead.meshes.push_back(mesh);
    }
    std::sort(ahead.meshes.begin(), ahead.meshes.end(), std::less<>());
    if (arrays.bytes() >= kLeastBytes)
        ahead.arrays = std::make_shared<ArraysAhead>(file, arrays.take());
    return ahead.arrays;
}

ArraysAhead::ArraysAhead(std::shared_ptr<const FileBytes> file, std::vector<const StoredArray*> arrays)
    : mFile(std::move(file)), mArrays(std::move(arrays)), mPlaces(placesOf(mArrays)), mInflated(mArrays.size()),
      mWork(sizesOf(mArrays), kMostReadyBytes,
            [this](std::size_t i) { mInflated[i] = std::make_unique<InflatedBytes>(mFile, *mArrays[i]); }) {}

std::unique_ptr<InflatedBytes> ArraysAhead::take(const StoredArray& array) {
    const auto found = mPlaces.find(&array);
    return found != mPlaces.end() && mWork.take(found->second) ? std::move(mInflated[found->second]) : nullptr;
}

} // namespace detail
FBXSDK_NAMESPACE_END
