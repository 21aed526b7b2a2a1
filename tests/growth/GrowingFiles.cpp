// SPDX-License-Identifier: MIT
// Copyright (c) Tarnell FBX contributors
//
// Each kind is a line of objects and connections that is repeated, and a common part.
#include "GrowingFiles.h"

#include <initializer_list>

namespace growth {
namespace {

constexpr char kTriangle[] = "Vertices: *9 {\na: 0,0,0,1,0,0,0,1,0\n}\nPolygonVertexIndex: *3 {\na: 0,1,-3\n}\n";
constexpr char kMatrix[] = "*16 {\na: 1,0,0,0,0,1,0,0,0,0,1,0,0,0,0,1\n}\n";

class File {
public:
    File& object(const char* record, int id, const std::string& name, const char* kind, const std::string& body = "") {
        mObjects += std::string(record) + ": " + std::to_string(id) + ", \"" + nameClass(record, kind) + "::" + name +
                    "\", \"" + kind + "\" {\nVersion: 232\n" + body + "}\n";
        return *this;
    }
    File& model(int id, const std::string& name, const char* kind = "Null", int parent = 0) {
        return object("Model", id, name, kind).connect(id, parent);
    }
    File& mesh(int id, int model) { return object("Geometry", id, "", "Mesh", kTriangle).connect(id, model); }
    File& connect(int source, int destination, const char* property = nullptr) {
        mConnections += std::string("C: \"") + (property ? "OP" : "OO") + "\"," + std::to_string(source) + ',' +
                        std::to_string(destination) + (property ? ",\"" + std::string(property) + '"' : "") + '\n';
        return *this;
    }
    /// A stack with a layer.
    File& animation() { return stack(2, "Take 001").object("AnimationLayer", 3, "Base", "").connect(3, 2); }
    File& stack(int id, const std::string& name) {
        return object("AnimationStack", id, name, "",
                      properties("P: \"LocalStop\", \"KTime\", \"Time\", \"\",46186158000\n"));
    }
    File& curve(int id) {
        return object("AnimationCurve", id, "", "",
                      "Default: 0\nKeyVer: 4008\nKeyTime: *2 {\na: 0,46186158000\n}\nKeyValueFloat: *2 {\na: 0,1\n}\n"
                      "KeyAttrFlags: *1 {\na: 4\n}\nKeyAttrDataFloat: *4 {\na: 0,0,0,0\n}\nKeyAttrRefCount: *1 {\na: "
                      "2\n}\n");
    }
    File& curveNode(int id, int owner, const std::string& body = "") {
        return object("AnimationCurveNode", id, "T", "", body).connect(id, 3).connect(id, owner, "Lcl Translation");
    }
    static std::string properties(const std::string& lines) { return "Properties70: {\n" + lines + "}\n"; }

    [[nodiscard]] std::string text() const {
        return "; FBX 7.4.0 project file\nFBXHeaderExtension: {\nFBXVersion: 7400\n}\nGlobalSettings: {\n" +
               properties("P: \"UnitScaleFactor\", \"double\", \"Number\", \"\",2.54\n"
                          "P: \"UpAxis\", \"int\", \"Integer\", \"\",2\nP: \"UpAxisSign\", \"int\", \"Integer\", "
                          "\"\",1\nP: \"FrontAxis\", \"int\", \"Integer\", \"\",1\nP: \"FrontAxisSign\", \"int\", "
                          "\"Integer\", \"\",-1\nP: \"CoordAxis\", \"int\", \"Integer\", \"\",0\nP: "
                          "\"CoordAxisSign\", \"int\", \"Integer\", \"\",1\n") +
               "}\nObjects: {\n" + mObjects + "}\nConnections: {\n" + mConnections + "}\n";
    }

private:
    static std::string nameClass(const std::string& record, const std::string& kind) {
        if (record == "Deformer")
            return kind == "Skin" || kind == "BlendShape" ? "Deformer" : "SubDeformer";
        if (record == "AnimationStack" || record == "AnimationLayer" || record == "AnimationCurveNode")
            return "Anim" + record.substr(9);
        return record == "AnimationCurve" ? "AnimCurve" : record;
    }

    std::string mObjects, mConnections;
};

std::string numbered(const char* name, int number) { return name + std::to_string(number); }

/// Ids of the repeated objects; those of the others are smaller.
constexpr int kFirst = 100, kStep = 10;

template <class Each>
std::string repeated(File file, int count, Each each) {
    for (int i = 0; i < count; ++i)
        each(file, kFirst + kStep * i, i);
    return file.text();
}

/// The scene for deformers: a model with a mesh.
File withMesh() { return File().model(10, "m", "Mesh").mesh(11, 10); }

std::string nulls(int count) {
    return repeated(
        File(), count, [](File& file, int id, int i) { file.model(id, numbered("n", i)); });
}
std::string nullsOfOneName(int count) {
    return repeated(
        File(), count, [](File& file, int id, int) { file.model(id, "n"); });
}
std::string nullsOfLongNames(int count) {
    return repeated(
        File(), count, [](File& file, int id, int i) { file.model(id, std::string(400, 'x') + std::to_string(i)); });
}
std::string childrenOfOne(int count) {
    return repeated(
        File().model(10, "parent"), count,
        [](File& file, int id, int i) { file.model(id, numbered("n", i), "Null", 10); });
}
std::string chain(int count) {
    return repeated(
        File(), count,
        [](File& file, int id, int i) { file.model(id, numbered("n", i), "Null", i > 0 ? id - kStep : 0); });
}
std::string childrenOfTwo(int count) {
    return repeated(
        File().model(10, "a").model(11, "b"), count,
        [](File& file, int id, int i) { file.model(id, numbered("n", i), "Null", 10).connect(id, 11); });
}
std::string doubledConnections(int count) {
    return repeated(
        File().model(10, "a").model(11, "b", "Null", 10), count, [](File& file, int, int) { file.connect(11, 10); });
}
template <const char* const& attribute>
std::string attributes(int count) {
    return repeated(
        File(), count,
        [](File& file, int id, int i) {
            file.model(id, numbered("a", i), attribute)
                .object("NodeAttribute", id + 1, "", attribute, std::string("TypeFlags: \"") + attribute + "\"\n")
                .connect(id + 1, id);
        });
}
constexpr const char* kCamera = "Camera";
constexpr const char* kLight = "Light";
constexpr const char* kMarker = "Marker";
constexpr const char* kBone = "LimbNode";
std::string attributesOfOne(int count) {
    return repeated(
        File().model(10, "a"), count,
        [](File& file, int id, int) {
            file.object("NodeAttribute", id, "", "Null", "TypeFlags: \"Null\"\n").connect(id, 10);
        });
}
std::string targets(int count) {
    return repeated(
        File().model(10, "target"), count,
        [](File& file, int id, int i) { file.model(id, numbered("n", i)).connect(10, id, "LookAtProperty"); });
}
std::string targetsOfOne(int count) {
    return repeated(
        File().model(10, "looking"), count,
        [](File& file, int id, int i) { file.model(id, numbered("n", i)).connect(id, 10, "LookAtProperty"); });
}

std::string meshes(int count) {
    return repeated(
        File(), count, [](File& file, int id, int i) { file.model(id, numbered("m", i), "Mesh").mesh(id + 1, id); });
}
std::string instances(int count) {
    return repeated(
        File().object("Geometry", 11, "", "Mesh", kTriangle), count,
        [](File& file, int id, int i) { file.model(id, numbered("m", i), "Mesh").connect(11, id); });
}
std::string surfaces(int count) {
    constexpr char kSurface[] =
        "NurbOrder: 2,2\nDimensions: 2,2\nStep: 1,1\nForm: \"Open\",\"Open\"\nPoints: *16 {\na: "
        "0,0,0,1,1,0,0,1,0,1,0,1,1,1,0,1\n}\nKnotVectorU: *4 {\na: 0,0,1,1\n}\nKnotVectorV: *4 {\na: 0,0,1,1\n}\n";
    return repeated(File(), count, [&](File& file, int id, int i) {
        file.model(id, numbered("s", i), "Nurb").object("Geometry", id + 1, "", "Nurb", kSurface).connect(id + 1, id);
    });
}

std::string materials(int count) {
    return repeated(
        File(), count,
        [](File& file, int id, int i) {
            file.model(id, numbered("m", i), "Mesh")
                .mesh(id + 1, id)
                .object("Material", id + 2, numbered("s", i), "", "ShadingModel: \"phong\"\n")
                .connect(id + 2, id);
        });
}
std::string materialsOfOne(int count) {
    return repeated(
        withMesh(), count,
        [](File& file, int id, int i) {
            file.object("Material", id, numbered("s", i), "", "ShadingModel: \"phong\"\n").connect(id, 10);
        });
}
std::string nodesOfOneMaterial(int count) {
    return repeated(
        File().object("Material", 20, "s", "", "ShadingModel: \"phong\"\n"), count,
        [](File& file, int id, int i) { file.model(id, numbered("m", i), "Mesh").mesh(id + 1, id).connect(20, id); });
}
std::string texturesOfOne(int count) {
    return repeated(
        withMesh().object("Material", 20, "s", "", "ShadingModel: \"phong\"\n").connect(20, 10), count,
        [](File& file, int id, int i) {
            file.object("Texture", id, numbered("t", i), "", "FileName: \"t.png\"\n")
                .connect(id, 20, "DiffuseColor")
                .object("Video", id + 1, numbered("v", i), "Clip", "Filename: \"t.png\"\n")
                .connect(id + 1, id);
        });
}

std::string skinsOfOne(int count) {
    return repeated(
        withMesh(), count,
        [](File& file, int id, int i) { file.object("Deformer", id, numbered("s", i), "Skin").connect(id, 11); });
}
std::string clustersOfOne(int count) {
    const std::string body = std::string("Indexes: *1 {\na: 0\n}\nWeights: *1 {\na: 1\n}\nTransform: ") + kMatrix +
                             "TransformLink: " + kMatrix;
    return repeated(withMesh().object("Deformer", 12, "s", "Skin").connect(12, 11), count,
                    [&](File& file, int id, int i) {
                        file.object("Deformer", id, numbered("c", i), "Cluster", body)
                            .connect(id, 12)
                            .model(id + 1, numbered("b", i), "LimbNode")
                            .connect(id + 1, id);
                    });
}
std::string blendShapesOfOne(int count) {
    return repeated(
        withMesh(), count,
        [](File& file, int id, int i) { file.object("Deformer", id, numbered("b", i), "BlendShape").connect(id, 11); });
}
constexpr char kShape[] = "Indexes: *1 {\na: 0\n}\nVertices: *3 {\na: 1,0,0\n}\nNormals: *3 {\na: 0,0,0\n}\n";
std::string channelsOfOne(int count) {
    return repeated(
        withMesh().object("Deformer", 12, "b", "BlendShape").connect(12, 11), count,
        [](File& file, int id, int i) {
            file.object("Deformer", id, numbered("c", i), "BlendShapeChannel", "DeformPercent: 0\n")
                .connect(id, 12)
                .object("Geometry", id + 1, numbered("g", i), "Shape", kShape)
                .connect(id + 1, id);
        });
}
std::string shapesOfOne(int count) {
    return repeated(
        withMesh()
            .object("Deformer", 12, "b", "BlendShape")
            .connect(12, 11)
            .object("Deformer", 13, "c", "BlendShapeChannel", "DeformPercent: 0\n")
            .connect(13, 12),
        count,
        [](File& file, int id, int i) {
            file.object("Geometry", id, numbered("g", i), "Shape", kShape).connect(id, 13);
        });
}

std::string stacks(int count) {
    return repeated(
        File(), count, [](File& file, int id, int i) { file.stack(id, numbered("Take ", i)); });
}
/// Each moves a null of its own.
std::string movingStacks(int count) {
    return repeated(
        File(), count,
        [](File& file, int id, int i) {
            file.stack(id, numbered("Take ", i))
                .object("AnimationLayer", id + 1, "Base", "")
                .connect(id + 1, id)
                .model(id + 2, numbered("n", i))
                .object("AnimationCurveNode", id + 3, "T", "")
                .connect(id + 3, id + 1)
                .connect(id + 3, id + 2, "Lcl Translation")
                .curve(id + 4)
                .connect(id + 4, id + 3, "d|X");
        });
}
std::string layers(int count) {
    return repeated(
        File().stack(2, "Take 001"), count,
        [](File& file, int id, int i) { file.object("AnimationLayer", id, numbered("L", i), "").connect(id, 2); });
}
std::string movingNulls(int count) {
    return repeated(
        File().animation(), count,
        [](File& file, int id, int i) {
            file.model(id, numbered("n", i)).curveNode(id + 1, id).curve(id + 2).connect(id + 2, id + 1, "d|X");
        });
}
std::string curvesOfOneChannel(int count) {
    return repeated(
        File().animation().model(10, "n").curveNode(11, 10), count,
        [](File& file, int id, int) { file.curve(id).connect(id, 11, "d|X"); });
}
std::string curveOfManyNodes(int count) {
    return repeated(
        File().animation().curve(10), count,
        [](File& file, int id, int i) {
            file.model(id, numbered("n", i)).curveNode(id + 1, id).connect(10, id + 1, "d|X");
        });
}
std::string channelsOfOneNode(int count) {
    return repeated(
        File().animation().model(10, "n").curveNode(11, 10), count,
        [](File& file, int id, int i) { file.curve(id).connect(id, 11, numbered("d|c", i).c_str()); });
}
std::string curveNodesOfOneProperty(int count) {
    return repeated(
        File().animation().model(10, "n"), count,
        [](File& file, int id, int) { file.curveNode(id, 10).curve(id + 1).connect(id + 1, id, "d|X"); });
}

std::string userProperties(int count) {
    std::string lines;
    for (int i = 0; i < count; ++i)
        lines += "P: \"" + numbered("u", i) + "\", \"double\", \"Number\", \"U\",1\n";
    return File().object("Model", 10, "n", "Null", File::properties(lines)).connect(10, 0).text();
}
std::string animatedUserProperties(int count) {
    std::string lines;
    for (int i = 0; i < count; ++i)
        lines += "P: \"" + numbered("u", i) + "\", \"double\", \"Number\", \"AU\",1\n";
    const File file = File().animation().object("Model", 10, "n", "Null", File::properties(lines)).connect(10, 0);
    return repeated(file, count, [](File& each, int id, int i) {
        each.object("AnimationCurveNode", id, numbered("u", i), "")
            .connect(id, 3)
            .connect(id, 10, numbered("u", i).c_str())
            .curve(id + 1)
            .connect(id + 1, id, numbered("d|u", i).c_str());
    });
}
std::string poses(int count) {
    const std::string body =
        std::string("Type: \"BindPose\"\nNbPoseNodes: 1\nPoseNode: {\nNode: 10\nMatrix: ") + kMatrix + "}\n";
    return repeated(File().model(10, "n"), count,
                    [&](File& file, int id, int i) { file.object("Pose", id, numbered("p", i), "BindPose", body); });
}
std::string nodesOfOnePose(int count) {
    std::string body = "Type: \"BindPose\"\nNbPoseNodes: " + std::to_string(count) + '\n';
    for (int i = 0; i < count; ++i)
        body += "PoseNode: {\nNode: " + std::to_string(kFirst + kStep * i) + "\nMatrix: " + kMatrix + "}\n";
    return repeated(File().object("Pose", 10, "p", "BindPose", body), count,
                    [](File& file, int id, int i) { file.model(id, numbered("n", i)); });
}

} // namespace

const std::vector<Kind>& kinds() {
    static const std::vector<Kind> kKinds = {
        {"nulls", nulls},
        {"nullsOfOneName", nullsOfOneName},
        {"nullsOfLongNames", nullsOfLongNames},
        {"childrenOfOne", childrenOfOne},
        {"chain", chain},
        {"childrenOfTwo", childrenOfTwo},
        {"doubledConnections", doubledConnections},
        {"cameras", attributes<kCamera>},
        {"lights", attributes<kLight>},
        {"markers", attributes<kMarker>},
        {"bones", attributes<kBone>},
        {"attributesOfOne", attributesOfOne},
        {"targets", targets},
        {"targetsOfOne", targetsOfOne},
        {"meshes", meshes},
        {"instances", instances},
        {"surfaces", surfaces},
        {"materials", materials},
        {"materialsOfOne", materialsOfOne},
        {"nodesOfOneMaterial", nodesOfOneMaterial},
        {"texturesOfOne", texturesOfOne},
        {"skinsOfOne", skinsOfOne},
        {"clustersOfOne", clustersOfOne},
        {"blendShapesOfOne", blendShapesOfOne},
        {"channelsOfOne", channelsOfOne},
        {"shapesOfOne", shapesOfOne},
        {"stacks", stacks},
        {"movingStacks", movingStacks},
        {"layers", layers},
        {"movingNulls", movingNulls},
        {"curvesOfOneChannel", curvesOfOneChannel},
        {"curveOfManyNodes", curveOfManyNodes},
        {"channelsOfOneNode", channelsOfOneNode},
        {"curveNodesOfOneProperty", curveNodesOfOneProperty},
        {"userProperties", userProperties},
        {"animatedUserProperties", animatedUserProperties},
        {"poses", poses},
        {"nodesOfOnePose", nodesOfOnePose},
    };
    return kKinds;
}

} // namespace growth
