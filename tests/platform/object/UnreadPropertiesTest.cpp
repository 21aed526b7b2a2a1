// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Properties that are read at the first question, and what happens when that fails.
#include <memory>
#include <new>

#include <gtest/gtest.h>

#include <fbxsdk/FbxManager.h>
#include <fbxsdk/FbxObject.h>

#include "object/ManagerData.h"

namespace {

using namespace fbxsdk;

/// Makes two dynamic properties; fails behind the first as often as it was told.
class TwoProperties final : public detail::PropertySource {
public:
    explicit TwoProperties(int failures) : mFailures(failures) {}

    void read(FbxObject& object, std::size_t place) const override {
        EXPECT_EQ(place, 7U);
        ++reads;
        FbxProperty::Create(&object, FbxIntDT, "first").Set(1);
        if (mFailures > 0) {
            --mFailures;
            throw std::bad_alloc();
        }
        FbxProperty::Create(&object, FbxIntDT, "second").Set(2);
    }

    mutable int reads = 0;

private:
    mutable int mFailures;
};

class UnreadProperties : public testing::Test {
protected:
    UnreadProperties() : manager(FbxManager::Create()), object(FbxObject::Create(manager, "object")) {}
    ~UnreadProperties() override { manager->Destroy(); }

    std::shared_ptr<TwoProperties> give(int failures = 0) {
        auto source = std::make_shared<TwoProperties>(failures);
        object->data().readPropertiesLater(source, 7);
        return source;
    }

    FbxManager* manager;
    FbxObject* object;
};

TEST_F(UnreadProperties, AreReadOnce) {
    const auto source = give();
    EXPECT_EQ(source->reads, 0);
    EXPECT_EQ(object->FindProperty("second").Get<FbxInt>(), 2);
    EXPECT_EQ(object->FindProperty("first").Get<FbxInt>(), 1);
    EXPECT_EQ(object->data().propertyCount(), 2);
    EXPECT_EQ(source->reads, 1);
    EXPECT_EQ(source.use_count(), 1) << "the source is let go";
}

TEST_F(UnreadProperties, StayUnreadWhenReadingFails) {
    const auto source = give(2);
    EXPECT_THROW((void)object->FindProperty("first"), std::bad_alloc);
    EXPECT_THROW((void)object->data().propertyCount(), std::bad_alloc);
    EXPECT_EQ(object->data().propertyCount(), 2);
    EXPECT_EQ(object->FindProperty("first").Get<FbxInt>(), 1);
    EXPECT_EQ(source->reads, 3);
}

TEST_F(UnreadProperties, AreNotReadToFreeTheObject) {
    const auto source = give();
    object->Destroy();
    EXPECT_EQ(source->reads, 0);
    EXPECT_EQ(source.use_count(), 1);
}

} // namespace
