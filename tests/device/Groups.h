#ifndef VORL_TESTS_DEVICE_GROUPS_H
#define VORL_TESTS_DEVICE_GROUPS_H

// The groups of scenes; the names of a group's scenes begin with its own name and a slash. Each has
// its stored output in `expected`, which scripts/device-reference.sh writes.

void BitmapScenes();     // bitmap/
void BlitScenes();       // blt/
void ClipScenes();       // clip/
void ConvertScenes();    // convert/
void DashScenes();       // dash/
void DibScenes();        // dib/
void HandleScenes();     // handle/
void LineScenes();       // line/
void MirrorScenes();     // mirror/
void MonoScenes();       // mono/
void ObjectScenes();     // object/
void OctantScenes();     // octant/
void OverlapScenes();    // overlap/
void PenScenes();        // pen/
void PolygonScenes();    // polygon/
void RectangleScenes();  // rectangle/
void Rop2Scenes();       // rop2/
void Rop3Scenes();       // rop3/
void ShapeScenes();      // shape/
void StateScenes();      // state/
void StretchScenes();    // stretch/
void TextScenes();       // text/
void WideScenes();       // wide/

#endif
