#ifndef VORL_GUI_GRAPHICVIEWPORTMODES_H
#define VORL_GUI_GRAPHICVIEWPORTMODES_H

/// @file
/// How a viewport is sized, aligned and switched.

inline namespace vorl {

/// How one direction of a viewport is sized when its transformation is computed.
enum ViewMode : unsigned char {
  ViewMode_Free = 0,      ///< keeps its scale
  ViewMode_Fit = 1,       ///< shows the whole graphic area
  ViewMode_Original = 2,  ///< scale 1
  ViewMode_Maximum = 3,   ///< the maximum scale
  ViewMode_Minimum = 4    ///< the minimum scale
};

/// Where the graphic area stands when the viewport shows more than it: one rule for each direction.
enum ViewAlignment : unsigned char {
  ViewAlignment_None = 0,
  ViewAlignment_Top = 1,
  ViewAlignment_Bottom = 2,
  ViewAlignment_CenterY = 3,
  ViewAlignment_Left = 4,
  ViewAlignment_Right = 8,
  ViewAlignment_CenterX = 12
};

/// The switches of a viewport.
enum ViewPortFlag : short {
  ViewPortFlag_Visible = 0x0001,
  ViewPortFlag_Proportional = 0x0002,      ///< x and y keep one scale
  ViewPortFlag_ClipBorders = 0x0004,       ///< drawing is clipped to the draw window
  ViewPortFlag_FixedGraphicArea = 0x0008,  ///< the scroll range is the graphic area alone
  ViewPortFlag_ScaleX = 0x0100,            ///< what the mouse may do
  ViewPortFlag_ScaleY = 0x0200,
  ViewPortFlag_PanX = 0x0400,
  ViewPortFlag_PanY = 0x0800,
  ViewPortFlag_MoveX = 0x1000,
  ViewPortFlag_MoveY = 0x2000
};

}  // namespace vorl

#endif
