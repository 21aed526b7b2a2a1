// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Connections: reading their records, and validating the set of them: both ends exist, none is duplicated, and the
// Models form a tree below the root.
#include <algorithm>
#include <array>
#include <numeric>
#include <tuple>

#include "document/DocumentBuilder.h"
#include "schema/ProducerCameras.h"
#include "schema/SubClasses.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {
namespace {

/// The positions of the ends in a connection record; -1 for a property that this kind of connection does not name.
struct ConnectionLayout {
    std::string_view type;
    int source, sourceProperty, destination, destinationProperty;
};
constexpr ConnectionLayout kConnectionLayouts[] = {
    {"OO", 1, -1, 2, -1},
    {"OP", 1, -1, 2, 3},
    {"PO", 1, 2, 3, -1},
    {"PP", 1, 2, 3, 4},
};

/// Models of these names stay out of the node tree when no connection includes them: they are the application's views.
bool isViewModel(const DocumentObject& object) {
    if (object.subClass == SubClass::kCameraSwitcher)
        return object.name == kCameraSwitcherName;
    return object.subClass == SubClass::kCamera && std::find(kProducerCameraNames.begin(), kProducerCameraNames.end(),
                                                             object.name) != kProducerCameraNames.end();
}

bool endsExist(const Document& document, const DocumentConnection& connection) {
    return document.find(connection.source) && (connection.destination == 0 || document.find(connection.destination));
}

void dropImpossible(DocumentBuilder& builder) {
    const Document& document = builder.document();
    auto& connections = builder.document().connections;
    const std::size_t toItself = std::erase_if(
        connections, [](const DocumentConnection& connection) { return connection.source == connection.destination; });
    const std::size_t unknown = std::erase_if(
        connections, [&](const DocumentConnection& connection) { return !endsExist(document, connection); });
    if (toItself != 0)
        builder.warn(std::to_string(toItself) + " connections link an object to itself; they are left out");
    if (unknown != 0)
        builder.warn(std::to_string(unknown) + " connections refer to objects that do not exist; they are left out");
}

void dropDoubled(std::vector<DocumentConnection>& connections) {
    const auto key = [&](std::uint32_t index) {
        const DocumentConnection& connection = connections[index];
        return std::tie(connection.source, connection.destination, connection.destinationProperty,
                        connection.sourceProperty);
    };
    std::vector<std::uint32_t> order(connections.size());
    std::iota(order.begin(), order.end(), 0U);
    std::sort(order.begin(), order.end(), [&](std::uint32_t a, std::uint32_t b) {
        return std::tuple_cat(key(a), std::tie(a)) < std::tuple_cat(key(b), std::tie(b));
    });
    std::vector<bool> doubled(connections.size(), false);
    for (std::size_t i = 1; i < order.size(); ++i)
        doubled[order[i]] = key(order[i]) == key(order[i - 1]);
    std::size_t position = 0;
    std::erase_if(connections, [&](const DocumentConnection&) { return doubled[position++]; });
}

/// The parents of all Models, as indices: of the object the connection comes from, to the connection itself.
class ModelTree {
public:
    explicit ModelTree(DocumentBuilder& builder)
        : mBuilder(builder), mDocument(builder.document()), mParentEdge(mDocument.objects.size(), kNone) {}

    void makeSound() {
        keepFirstParents();
        breakCycles();
        attachOrphans();
    }

private:
    static constexpr std::uint32_t kNone = ~0U;

    [[nodiscard]] const DocumentObject* modelOf(std::int64_t id) const {
        const DocumentObject* object = mDocument.find(id);
        return object && object->record == "Model" ? object : nullptr;
    }
    [[nodiscard]] std::uint32_t indexOf(const DocumentObject& object) const {
        return static_cast<std::uint32_t>(&object - mDocument.objects.data());
    }

    /// The Model to which the connection gives a parent; null when it is not of that kind.
    [[nodiscard]] const DocumentObject* childOf(const DocumentConnection& connection) const {
        if (!connection.sourceProperty.empty() || !connection.destinationProperty.empty())
            return nullptr;
        const DocumentObject* child = modelOf(connection.source);
        return child && (connection.destination == 0 || modelOf(connection.destination)) ? child : nullptr;
    }

    void keepFirstParents() {
        auto& connections = mDocument.connections;
        std::uint32_t kept = 0;
        for (std::uint32_t i = 0; i < connections.size(); ++i) {
            if (const DocumentObject* child = childOf(connections[i])) {
                std::uint32_t& edge = mParentEdge[indexOf(*child)];
                if (edge != kNone) {
                    mBuilder.warn("the Model " + quotedName(child->name) +
                                  " has more than one parent; the first one is used");
                    continue;
                }
                edge = kept;
            }
            connections[kept++] = connections[i];
        }
        connections.resize(kept);
    }

    /// The index of the Model's parent; kNone below the root and for unparented Models.
    [[nodiscard]] std::uint32_t parentOf(std::uint32_t model) const {
        const std::uint32_t edge = mParentEdge[model];
        if (edge == kNone || mDocument.connections[edge].destination == 0)
            return kNone;
        return indexOf(*mDocument.find(mDocument.connections[edge].destination));
    }

    /// Walks up from every Model once; a walk that meets itself again has found a cycle.
    void breakCycles() {
        constexpr std::uint32_t kUnseen = 0;
        std::vector<std::uint32_t> walkOf(mDocument.objects.size(), kUnseen);
        std::uint32_t walk = kUnseen;
        for (std::uint32_t start = 0; start < walkOf.size(); ++start) {
            ++walk;
            std::uint32_t model = start;
            while (model != kNone && walkOf[model] == kUnseen) {
                walkOf[model] = walk;
                model = parentOf(model);
            }
            if (model == kNone || walkOf[model] != walk)
                continue;
            mDocument.connections[mParentEdge[model]].destination = 0;
            mBuilder.warn("the Model " + quotedName(mDocument.objects[model].name) +
                          " is its own ancestor; it is placed below the root");
        }
    }

    void attachOrphans() {
        for (std::size_t i = 0; i < mDocument.objects.size(); ++i) {
            const DocumentObject& object = mDocument.objects[i];
            if (object.record == "Model" && mParentEdge[i] == kNone && !isViewModel(object))
                mBuilder.connect(object.id, 0);
        }
    }

    DocumentBuilder& mBuilder;
    Document& mDocument;
    std::vector<std::uint32_t> mParentEdge; ///< per object, the connection to its parent
};

} // namespace

ConnectionEnds connectionEnds(const Record& record) {
    const std::string_view type = record.value(0).toText();
    const auto* layout = std::find_if(std::begin(kConnectionLayouts), std::end(kConnectionLayouts),
                                      [&](const ConnectionLayout& row) { return row.type == type; });
    if (layout == std::end(kConnectionLayouts))
        return {};
    const auto valueAt = [&](int position) -> const Value& { return record.value(static_cast<std::size_t>(position)); };
    const auto textAt = [&](int position) { return position < 0 ? std::string_view() : valueAt(position).toText(); };
    return {&valueAt(layout->source), &valueAt(layout->destination), textAt(layout->sourceProperty),
            textAt(layout->destinationProperty)};
}

void cleanConnections(DocumentBuilder& builder) {
    dropImpossible(builder);
    dropDoubled(builder.document().connections);
    ModelTree(builder).makeSound();
}

} // namespace detail
FBXSDK_NAMESPACE_END
