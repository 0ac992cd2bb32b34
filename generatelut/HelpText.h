#pragma once

// The texts that the panel shows, as HTML.

#define GENERATELUT_FORMAT_LIST                                \
    "<ul> <li>.3dl  : Autodesk/Scratch format</li>"            \
    " <li>.blut : Houdini mplay blut format</li>"              \
    " <li>.cms  : CMS file format (includes the 1D LUT).</li>" \
    " <li>.csp  : CineSpace format</li>"                       \
    " <li>.cub  : Truelight LUT format</li>"                   \
    " <li>.cube : Iridas LUT format</li>"                      \
    " <li>.vf   : Zefra's Vectorfield operator</li> </ul>"

namespace generatelut {

constexpr char kHelp[] =
    "Generate Color Management Lookup Tables."
    "<p>Input must be the output of a CMSTestPattern operator, passed through a sequence of "
    "operators"
    " that produce the desired color correction.</p>"
    "<p>The size of the 3D LUT is controlled by the Test Pattern generator node, not this one. This"
    " node looks at the size of the image it gets and figures out the size of LUT to be"
    " generated.</p>"
    "The following extensions/file formats are recognized:" GENERATELUT_FORMAT_LIST;

constexpr char kFileTip[] =
    "LUT data will be written into this file. The following filename extensions are"
    " recognized:" GENERATELUT_FORMAT_LIST;

constexpr char kFileTypeTip[] =
    "If the file type is blank, the format will be guessed from the filename, but you will not be"
    " able to set any type-specific controls.";

constexpr char kLut1dTip[] = "This is the size of the 1D lookup table. The default value is 1024.";

constexpr char kStyle1dTip[] =
    "Some systems assume the LUT is designed to apply to log images, others linear. Some LUT "
    "formats"
    " are assumed to encode values as either log or linear. Use this setting to get your output LUT"
    " values encoded the way your use of the LUT requires.";

constexpr char kBitDepthTip[] =
    "The bit depth to scale input values to for .3dl files. For instance, a 10 bit file will have"
    " values between 0 and 1023.";

constexpr char kOutputBitDepthTip[] =
    "The bit depth to scale output values to for .3dl files. For instance, a 10 bit file will have"
    " values between 0 and 1023.  In general this should match the input bit depth.";

constexpr char kClampOutputTip[] =
    "Clamp 3dl output values to the range 0-1. Turning this off allows superwhite values to be"
    " represented which are allowed in some packages (e.g. Zefra). This may make the resulting file"
    " unreadable by other packages.";

constexpr char kFormat3dlTip[] =
    "There are several different specifications for integer 3dl files. Autodesk Flame, Smoke and"
    " Lustre prefer cube sizes of 17x17, 33x33 and 65x65. Autodesk Lustre outputs 3DMESH/Mesh "
    "header."
    " ASSIMULATE SCRATCH scales and offsets the 3D LUT.";

constexpr char kGenerateScript[] =
    "frame = int(zefra.Root()['frame'].value())\n"
    "zefra.executeMultiple([zefra.toNode(\"this\")], ([frame, frame, 1],))\n"
    "del frame";

}  // namespace generatelut
