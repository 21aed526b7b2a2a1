// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Items that are shown as the packed bytes of a file. A caller that reads them roughly in order accesses them through a
// sliding window, and the items before it are released.
#pragma once

#include <fbxsdk/FbxPlainArray.h>

#include "geometry/StoredBytes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

/// The window over the bytes; depends only on the size of the items.
class StoredWindow : public ItemSource {
public:
    StoredWindow(int count, std::size_t itemBytes) : mCount(count), mItemBytes(itemBytes) {}
    ~StoredWindow() override;

    [[nodiscard]] int count() const override { return mCount; }

    void moveWindow(int index) override;

protected:
    [[nodiscard]] bool hasBytes() const { return mBytes != nullptr; }
    void setBytes(std::unique_ptr<StoredBytes> bytes) { mBytes = std::move(bytes); }

private:
    void releaseUpTo(int end);

    std::unique_ptr<StoredBytes> mBytes;
    int mCount;
    std::size_t mItemBytes;
};

template <class Item>
class StoredItems : public StoredWindow {
public:
    explicit StoredItems(int count) : StoredWindow(count, kStoredBytes<Item>) {}
    StoredItems(std::unique_ptr<StoredBytes> bytes, int count) : StoredItems(count) { setBytes(std::move(bytes)); }

    [[nodiscard]] std::size_t itemSize() const override { return sizeof(Item); }
    [[nodiscard]] bool show() override { return hasBytes() && count() > 0; }
    [[nodiscard]] bool read(void* items) override {
        auto* const to = static_cast<Item*>(items);
        for (int i = 0; i < count(); ++i) {
            if (!hasInWindow(i))
                moveWindow(i);
            to[i] = storedItem<Item>(at(i, kStoredBytes<Item>));
        }
        return true;
    }
};

} // namespace detail
FBXSDK_NAMESPACE_END
