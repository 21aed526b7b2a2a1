// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Meshes whose arrays are long enough for several threads.
#pragma once

#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "Fbx.h"
#include "TnFbxError.h"
#include "TnFbxMesh.h"
#include "TnFbxWriteInfo.h"

namespace Tarnell::Fbx::test {

/// So many that the normals take a mebibyte as doubles, and more as text.
inline constexpr int kLongStrip = 12'000;

/// Squares in a row, with normals, texture coordinates and colours of many digits.
inline void fillStrip(TnFbxMesh& mesh, int squares) {
    ASSERT_TRUE(mesh.allocateGeometryData(squares, 2 * squares + 2, 4 * squares));
    for (int i = 0; i < mesh.getNumberOfControlPoints(); ++i)
        mesh.setControlPoint(i, static_cast<float>(i / 2), static_cast<float>(i % 2), 0.0f);
    for (int square = 0; square < squares; ++square) {
        mesh.setPolygonVertexSize(square, 4);
        for (int corner = 0; corner < 4; ++corner) {
            const int at = 4 * square + corner;
            mesh.setPointIndex(at, 2 * square + (corner == 1 ? 2 : corner == 2 ? 3 : corner / 3));
            mesh.setNormal(at, 1.0f / static_cast<float>(at + 1), 0.1f * static_cast<float>(corner), 1.0f);
            mesh.setUV(at, static_cast<float>(square), static_cast<float>(corner));
            mesh.setColour(at, 0.25f, 0.5f, 0.75f, 1.0f);
        }
    }
    mesh.setValidNormals(true);
    mesh.setValidUVs(true);
    mesh.setValidColours(true);
}

/// A mesh "strip" for each of the lengths.
inline void writeStrips(const std::string& fileName, const std::vector<int>& squares, bool ascii) {
    std::vector<TnFbxMesh> strips(squares.size());
    std::vector<TnFbxMesh*> meshes;
    for (std::size_t i = 0; i < squares.size(); ++i) {
        strips[i].setName("strip");
        fillStrip(strips[i], squares[i]);
        meshes.push_back(&strips[i]);
    }
    TnFbxWriteInfo info;
    info.setFileName(fileName);
    info.setFileFormat(ascii);
    info.setAnimationStackName("walk");
    info.setAnimateMeshVertices(false);
    EXPECT_TRUE(Fbx().writeFile(info, {}, {}, {}, {}, meshes)) << lastError();
}

} // namespace Tarnell::Fbx::test
