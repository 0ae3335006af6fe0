#ifndef VORL_FWD_H
#define VORL_FWD_H

/// @file
/// Forward declarations of every public class.

inline namespace vorl {

class BaseClass;
class ClassInfo;
class DataBase;
class HRTimer;
class ILogging;
class LogContext;
class LogManager;
class LogSession;
class LogTarget;
class LogThread;
class OpBase;
class dStatus;

class BinaryDataIn;
class BinaryDataOut;
class IBinaryDataIO;

class dASCIIStreamIn;
class dBCGLUT;
class dBuffer;
class dCoordSys1D;
class dCoordSys2D;
class dCoordSys3D;
class dDIB;
class dImaDescriptorDIB;
class dImage;
class dLUT;
class dPoint;
class dRect;
class dSlice;
class dString;
class dTrafo1D;
class dTrafo2D;
class dTrafo3D;
class dUnitTrafo;
struct dVOI;
class dVect2D;
class dVect3D;
class dVolume;
class dWindowingLUT;

class opDIB2Ima;
class opLookup;
class opMIP;
class opMPR;
class opMinMax;
class opPixelRescale;
class opSliceProjection;
class opVoxelClassification;

class AnchoredTrafo2D;
class Geom2D;
class Geom3D;
class GraphicHandler;
class GraphicViewPort;
class IGraphicHandler;
class IGraphicViewPort;
class IVGObjectView;
class InputEventHandler;
class MultiTrafo2D;
class Rect2D;
class Rotate2D;
class Scale2D;
class Trafo1D;
class Trafo2DBase;
class TrafoSRT2D;
class TrafoST2D;
class Translate2D;
class UnitTrafo;
class VGAnchorView;
class VGAxis;
class VGAxisView;
class VGBitmapView;
class VGCrossCursorView;
class VGCurve;
class VGCurveView;
class VGLine;
class VGLineView;
class VGObject;
class VGObjectView;
class VGPoint;
class VGPointView;
class VGRect;
class VGRectView;
class VGText;
class VGTextView;
class vIma2Device;

}  // namespace vorl

#endif
