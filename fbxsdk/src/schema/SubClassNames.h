// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Types of skeletons and markers as files spell them: the sub-class of the object.
#pragma once

#include <string_view>

#include <fbxsdk/FbxMarker.h>
#include <fbxsdk/FbxSkeleton.h>

FBXSDK_NAMESPACE_BEGIN
namespace detail {

template <class Type>
struct SubClassRow {
    std::string_view subClass;
    Type type;
};
inline constexpr SubClassRow<FbxSkeleton::EType> kSkeletonSubClasses[] = {{"Root", FbxSkeleton::eRoot},
                                                                          {"Limb", FbxSkeleton::eLimb},
                                                                          {"LimbNode", FbxSkeleton::eLimbNode},
                                                                          {"Effector", FbxSkeleton::eEffector}};
inline constexpr SubClassRow<FbxMarker::EType> kMarkerSubClasses[] = {{"Marker", FbxMarker::eStandard},
                                                                      {"OpticalMarker", FbxMarker::eOptical},
                                                                      {"FKEffector", FbxMarker::eEffectorFK},
                                                                      {"IKEffector", FbxMarker::eEffectorIK}};

[[nodiscard]] constexpr std::string_view subClassOf(FbxSkeleton::EType type) {
    for (const auto& row : kSkeletonSubClasses) {
        if (row.type == type)
            return row.subClass;
    }
    return "LimbNode";
}

[[nodiscard]] constexpr std::string_view subClassOf(FbxMarker::EType type) {
    for (const auto& row : kMarkerSubClasses) {
        if (row.type == type)
            return row.subClass;
    }
    return "Marker";
}

} // namespace detail
FBXSDK_NAMESPACE_END
