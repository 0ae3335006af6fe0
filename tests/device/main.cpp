// Draws small pictures through the device and prints one line for each: name, check sum of the
// pixels, results. Equal lines mean equal devices.
//
//   vorl_device_scenes                 runs everything
//   vorl_device_scenes --group GROUP   runs one group
//   vorl_device_scenes --only NAME     runs one scene
//   vorl_device_scenes --dump NAME     runs one scene and prints its pictures as text
//   vorl_device_scenes --list          prints the names

#include "Groups.h"
#include "Harness.h"

int main(int argc, char** argv) {
  return RunScenes(argc, argv, [] {
    LineScenes();
    Rop2Scenes();
    PenScenes();
    OctantScenes();
    DashScenes();
    WideScenes();
    ShapeScenes();
    PolygonScenes();
    RectangleScenes();
    ClipScenes();
    BlitScenes();
    Rop3Scenes();
    ConvertScenes();
    MonoScenes();
    OverlapScenes();
    StretchScenes();
    MirrorScenes();
    BitmapScenes();
    DibScenes();
    TextScenes();
    StateScenes();
    HandleScenes();
    ObjectScenes();
  });
}
