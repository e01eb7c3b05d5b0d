#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"
#include "foundation/zebmediatypes/AudioChannelDescription.h"

#include <vector>

namespace zebmediatypes
{

/// One element a channel, in channel order.
using ChannelLayout = std::vector<AudioChannelDescription>;

/// A text that names the layout: its labels in order, such as "L R C LFE Ls Rs", "Mono" for one channel without a
/// label, and the number of channels where none has a label. Empty for an empty layout. [any]
ZEB_EXPORT zebcore::UTF16String AudioChannelLayoutDescription(const ChannelLayout& layout);

// Each of the functions below returns a new layout. [any]

/// One channel without a label.
ZEB_EXPORT ChannelLayout CreateMonoChannelLayout();
/// L R.
ZEB_EXPORT ChannelLayout CreateStereoChannelLayout();
/// Lt Rt.
ZEB_EXPORT ChannelLayout CreateMatrixStereoChannelLayout();
/// L R Ls Rs.
ZEB_EXPORT ChannelLayout CreateQuadraphonicChannelLayout();
/// L R Ls Rs C.
ZEB_EXPORT ChannelLayout CreatePentagonalChannelLayout();
/// L R Ls Rs C Cs.
ZEB_EXPORT ChannelLayout CreateHexagonalChannelLayout();
/// L R Ls Rs C Cs Sl Sr.
ZEB_EXPORT ChannelLayout CreateOctagonalChannelLayout();
/// L R Ls Rs, then the four above them in the same order.
ZEB_EXPORT ChannelLayout CreateCubeChannelLayout();
/// W X Y Z.
ZEB_EXPORT ChannelLayout CreateAmbisonicsBFormatChannelLayout();
/// L R C LFE Ls Rs Lt Rt.
ZEB_EXPORT ChannelLayout CreateSmpteDtvChannelLayout();
/// L R C LFE Ls Rs.
ZEB_EXPORT ChannelLayout CreateBroadcast51ChannelLayout();
/// L R Ls Rs C LFE.
ZEB_EXPORT ChannelLayout CreateLegacy51ChannelLayout();
/// L R C LFE Ls Rs Lc Rc.
ZEB_EXPORT ChannelLayout Create7_1ChannelLayout();
/// L R C LFE Ls Rs Rls Rrs.
ZEB_EXPORT ChannelLayout Create7_1ItuChannelLayout();
/// C Lc Rc L R Ls Rs LFE.
ZEB_EXPORT ChannelLayout Create7_1MpegChannelLayout();
/// L R Ls Rs C LFE Lc Rc.
ZEB_EXPORT ChannelLayout Create7_1EMagicChannelLayout();

// The name lists the channels in order.

ZEB_EXPORT ChannelLayout Create_L_R_C_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_C_L_R_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_C_R_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_Cs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_LFE_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_C_Cs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_C_L_R_Cs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_C_R_Cs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_C_LFE_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_C_R_LFE_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_Cs_LFE_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_LFE_Cs_ChannelLayout();

ZEB_EXPORT ChannelLayout Create_L_R_C_Ls_Rs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_C_L_R_Ls_Rs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_C_R_Ls_Rs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_Ls_Rs_C_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_C_R_Cs_LFE_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_C_LFE_Cs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_LFE_Ls_Rs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_Ls_Rs_LFE_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_C_L_R_Ls_Rs_Cs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_C_L_R_Ls_Rs_LFE_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_C_R_Ls_Rs_LFE_ChannelLayout();

ZEB_EXPORT ChannelLayout Create_L_R_Ls_Rs_C_Lc_Rc_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_C_L_R_Ls_Rs_Cs_LFE_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_C_LFE_Ls_Rs_Cs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_C_L_R_Ls_Rs_Rls_Rrs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_L_R_Ls_Rs_C_Rls_Rrs_ChannelLayout();
ZEB_EXPORT ChannelLayout Create_C_L_R_Ls_Rs_Rls_Rrs_Cs_ChannelLayout();

} // namespace zebmediatypes
