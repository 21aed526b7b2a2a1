// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Which generation is written, and the conversion of parts that it keeps elsewhere.
#include "document/DocumentSections.h"
#include "document/legacy/InlineShapes.h"

FBXSDK_NAMESPACE_BEGIN
namespace detail {

void writeDocument(Document& document, const VersionTraits& traits, RecordSink& sink) {
    if (traits.inlineShapes)
        moveShapesInline(document);
    if (traits.generation == 7)
        writeGeneration7(document, traits, sink);
    else
        writeGeneration6(document, traits, sink);
}

} // namespace detail
FBXSDK_NAMESPACE_END
