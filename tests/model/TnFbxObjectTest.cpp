// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// The named root of the scene objects.
#include "TnFbxObject.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <type_traits>

namespace Tarnell::Fbx {
namespace {

TEST(TnFbxObject, StartsWithoutAName) { EXPECT_EQ(TnFbxObject().getName(), ""); }

TEST(TnFbxObject, KeepsTheNameItIsGiven) {
    TnFbxObject object;

    EXPECT_TRUE(object.setName("camera1"));

    EXPECT_EQ(object.getName(), "camera1");
}

TEST(TnFbxObject, KeepsEveryByteOfAName) {
    const std::string names[] = {"", std::string("a\0b", 3), "Kamera \xC3\xA4 \xE4\xB8\xAD", "\xFF\xFE",
                                 std::string(100000, 'x')};
    for (const std::string& name : names) {
        TnFbxObject object;
        object.setName(name);
        EXPECT_EQ(object.getName(), name);
    }
}

TEST(TnFbxObject, CopiesTheNameInsteadOfReferringToIt) {
    TnFbxObject object;
    std::string name = "before";

    object.setName(name);
    name = "after";

    EXPECT_EQ(object.getName(), "before");
}

TEST(TnFbxObject, TakesItsOwnName) {
    TnFbxObject object;
    object.setName("mine");

    EXPECT_TRUE(object.setName(object.getName()));

    EXPECT_EQ(object.getName(), "mine");
}

TEST(TnFbxObject, InitAndDeleteEmptyTheName) {
    TnFbxObject object;

    object.setName("a");
    EXPECT_TRUE(object.initObject());
    EXPECT_EQ(object.getName(), "");

    object.setName("b");
    EXPECT_TRUE(object.deleteObject());
    EXPECT_EQ(object.getName(), "");
}

TEST(TnFbxObject, AssignmentCopiesTheName) {
    TnFbxObject source;
    TnFbxObject target;
    source.setName("source");
    target.setName("target");

    target = source;

    EXPECT_EQ(target.getName(), "source");
    EXPECT_EQ(source.getName(), "source");
}

TEST(TnFbxObject, AssignmentToItselfKeepsTheName) {
    TnFbxObject object;
    object.setName("same");
    const TnFbxObject& alias = object;

    object = alias;

    EXPECT_EQ(object.getName(), "same");
}

TEST(TnFbxObject, IsDestroyedThroughABasePointer) {
    struct Derived : TnFbxObject {
        explicit Derived(bool& destroyed) : mDestroyed(destroyed) {}
        ~Derived() override { mDestroyed = true; }
        bool& mDestroyed;
    };
    bool destroyed = false;

    std::unique_ptr<TnFbxObject>(new Derived(destroyed)).reset();

    EXPECT_TRUE(destroyed);
    static_assert(std::has_virtual_destructor_v<TnFbxObject>);
}

} // namespace
} // namespace Tarnell::Fbx
