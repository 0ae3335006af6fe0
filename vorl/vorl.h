#ifndef VORL_VORL_H
#define VORL_VORL_H

/// @file
/// Everything public in one include. A program that cares for its build times includes the headers
/// that it uses.

#include <vorl/Common/BaseClass.h>
#include <vorl/Common/HRTimer.h>
#include <vorl/Common/ILogging.h>
#include <vorl/Common/LogContext.h>
#include <vorl/Common/LogManager.h>
#include <vorl/Common/OpBase.h>
#include <vorl/Common/dStatus.h>
#include <vorl/Data/dASCIIStream.h>
#include <vorl/Data/dBCGLUT.h>
#include <vorl/Data/dBuffer.h>
#include <vorl/Data/dCoordSys.h>
#include <vorl/Data/dDIB.h>
#include <vorl/Data/dImaDescriptorDIB.h>
#include <vorl/Data/dImage.h>
#include <vorl/Data/dLUT.h>
#include <vorl/Data/dPoint.h>
#include <vorl/Data/dRect.h>
#include <vorl/Data/dSlice.h>
#include <vorl/Data/dString.h>
#include <vorl/Data/dTrafo.h>
#include <vorl/Data/dVOI.h>
#include <vorl/Data/dVect2D.h>
#include <vorl/Data/dVect3D.h>
#include <vorl/Data/dVolume.h>
#include <vorl/Data/dWindowingLUT.h>
#include <vorl/GUI/Geom2D.h>
#include <vorl/GUI/GraphicHandler.h>
#include <vorl/GUI/GraphicViewPort.h>
#include <vorl/GUI/GraphicViewPortModes.h>
#include <vorl/GUI/InputEventHandler.h>
#include <vorl/GUI/Rect2D.h>
#include <vorl/GUI/Trafo1D.h>
#include <vorl/GUI/Trafo2D.h>
#include <vorl/GUI/VGAxis.h>
#include <vorl/GUI/VGBitmapView.h>
#include <vorl/GUI/VGCrossCursorView.h>
#include <vorl/GUI/VGCurve.h>
#include <vorl/GUI/VGLine.h>
#include <vorl/GUI/VGObjectView.h>
#include <vorl/GUI/VGPoint.h>
#include <vorl/GUI/VGRect.h>
#include <vorl/GUI/VGText.h>
#include <vorl/GUI/vIma2Device.h>
#include <vorl/IO/BinaryDataIO.h>
#include <vorl/IO/File/opDIB2Ima.h>
#include <vorl/Operators/IP/opLookup.h>
#include <vorl/Operators/IP/opMIP.h>
#include <vorl/Operators/IP/opMPR.h>
#include <vorl/Operators/IP/opMinMax.h>
#include <vorl/Operators/IP/opPixelRescale.h>
#include <vorl/Operators/IP/opSliceProjection.h>
#include <vorl/Operators/IP/opVoxelClassification.h>
#include <vorl/Platform/Gdi.h>
#include <vorl/Platform/GdiConstants.h>
#include <vorl/Platform/GdiFunctions.h>
#include <vorl/Platform/GdiFwd.h>
#include <vorl/Platform/GdiTypes.h>
#include <vorl/export.h>
#include <vorl/fwd.h>

#endif
