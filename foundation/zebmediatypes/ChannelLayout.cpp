#include "foundation/zebmediatypes/ChannelLayout.h"

namespace zebmediatypes
{

namespace
{

// The labels as the names of the layouts write them.
constexpr AudioChannelLabel kL = kAudioChannelLabel_Left;
constexpr AudioChannelLabel kR = kAudioChannelLabel_Right;
constexpr AudioChannelLabel kC = kAudioChannelLabel_Center;
constexpr AudioChannelLabel kLFE = kAudioChannelLabel_LFE;
constexpr AudioChannelLabel kLs = kAudioChannelLabel_LeftSurround;
constexpr AudioChannelLabel kRs = kAudioChannelLabel_RightSurround;
constexpr AudioChannelLabel kCs = kAudioChannelLabel_CenterSurround;
constexpr AudioChannelLabel kLc = kAudioChannelLabel_LeftCenter;
constexpr AudioChannelLabel kRc = kAudioChannelLabel_RightCenter;
constexpr AudioChannelLabel kRls = kAudioChannelLabel_RearLeftSurround;
constexpr AudioChannelLabel kRrs = kAudioChannelLabel_RearRightSurround;
constexpr AudioChannelLabel kSl = kAudioChannelLabel_SideLeft;
constexpr AudioChannelLabel kSr = kAudioChannelLabel_SideRight;
constexpr AudioChannelLabel kTfl = kAudioChannelLabel_TopFrontLeft;
constexpr AudioChannelLabel kTfr = kAudioChannelLabel_TopFrontRight;
constexpr AudioChannelLabel kTrl = kAudioChannelLabel_TopRearLeft;
constexpr AudioChannelLabel kTrr = kAudioChannelLabel_TopRearRight;
constexpr AudioChannelLabel kLt = kAudioChannelLabel_LeftTotal;
constexpr AudioChannelLabel kRt = kAudioChannelLabel_RightTotal;
constexpr AudioChannelLabel kW = kAudioChannelLabel_AmbisonicW;
constexpr AudioChannelLabel kX = kAudioChannelLabel_AmbisonicX;
constexpr AudioChannelLabel kY = kAudioChannelLabel_AmbisonicY;
constexpr AudioChannelLabel kZ = kAudioChannelLabel_AmbisonicZ;

} // namespace

ChannelLayout CreateMonoChannelLayout()
{
    return {kAudioChannelLabel_None};
}

ChannelLayout CreateStereoChannelLayout()
{
    return {kL, kR};
}

ChannelLayout CreateMatrixStereoChannelLayout()
{
    return {kLt, kRt};
}

ChannelLayout CreateQuadraphonicChannelLayout()
{
    return {kL, kR, kLs, kRs};
}

ChannelLayout CreatePentagonalChannelLayout()
{
    return {kL, kR, kLs, kRs, kC};
}

ChannelLayout CreateHexagonalChannelLayout()
{
    return {kL, kR, kLs, kRs, kC, kCs};
}

ChannelLayout CreateOctagonalChannelLayout()
{
    return {kL, kR, kLs, kRs, kC, kCs, kSl, kSr};
}

ChannelLayout CreateCubeChannelLayout()
{
    return {kL, kR, kLs, kRs, kTfl, kTfr, kTrl, kTrr};
}

ChannelLayout CreateAmbisonicsBFormatChannelLayout()
{
    return {kW, kX, kY, kZ};
}

ChannelLayout CreateSmpteDtvChannelLayout()
{
    return {kL, kR, kC, kLFE, kLs, kRs, kLt, kRt};
}

ChannelLayout CreateBroadcast51ChannelLayout()
{
    return {kL, kR, kC, kLFE, kLs, kRs};
}

ChannelLayout CreateLegacy51ChannelLayout()
{
    return {kL, kR, kLs, kRs, kC, kLFE};
}

ChannelLayout Create7_1ChannelLayout()
{
    return {kL, kR, kC, kLFE, kLs, kRs, kLc, kRc};
}

ChannelLayout Create7_1ItuChannelLayout()
{
    return {kL, kR, kC, kLFE, kLs, kRs, kRls, kRrs};
}

ChannelLayout Create7_1MpegChannelLayout()
{
    return {kC, kLc, kRc, kL, kR, kLs, kRs, kLFE};
}

ChannelLayout Create7_1EMagicChannelLayout()
{
    return {kL, kR, kLs, kRs, kC, kLFE, kLc, kRc};
}

ChannelLayout Create_L_R_C_ChannelLayout()
{
    return {kL, kR, kC};
}

ChannelLayout Create_C_L_R_ChannelLayout()
{
    return {kC, kL, kR};
}

ChannelLayout Create_L_C_R_ChannelLayout()
{
    return {kL, kC, kR};
}

ChannelLayout Create_L_R_Cs_ChannelLayout()
{
    return {kL, kR, kCs};
}

ChannelLayout Create_L_R_LFE_ChannelLayout()
{
    return {kL, kR, kLFE};
}

ChannelLayout Create_L_R_C_Cs_ChannelLayout()
{
    return {kL, kR, kC, kCs};
}

ChannelLayout Create_C_L_R_Cs_ChannelLayout()
{
    return {kC, kL, kR, kCs};
}

ChannelLayout Create_L_C_R_Cs_ChannelLayout()
{
    return {kL, kC, kR, kCs};
}

ChannelLayout Create_L_R_C_LFE_ChannelLayout()
{
    return {kL, kR, kC, kLFE};
}

ChannelLayout Create_L_C_R_LFE_ChannelLayout()
{
    return {kL, kC, kR, kLFE};
}

ChannelLayout Create_L_R_Cs_LFE_ChannelLayout()
{
    return {kL, kR, kCs, kLFE};
}

ChannelLayout Create_L_R_LFE_Cs_ChannelLayout()
{
    return {kL, kR, kLFE, kCs};
}

ChannelLayout Create_L_R_C_Ls_Rs_ChannelLayout()
{
    return {kL, kR, kC, kLs, kRs};
}

ChannelLayout Create_C_L_R_Ls_Rs_ChannelLayout()
{
    return {kC, kL, kR, kLs, kRs};
}

ChannelLayout Create_L_C_R_Ls_Rs_ChannelLayout()
{
    return {kL, kC, kR, kLs, kRs};
}

ChannelLayout Create_L_R_Ls_Rs_C_ChannelLayout()
{
    return {kL, kR, kLs, kRs, kC};
}

ChannelLayout Create_L_C_R_Cs_LFE_ChannelLayout()
{
    return {kL, kC, kR, kCs, kLFE};
}

ChannelLayout Create_L_R_C_LFE_Cs_ChannelLayout()
{
    return {kL, kR, kC, kLFE, kCs};
}

ChannelLayout Create_L_R_LFE_Ls_Rs_ChannelLayout()
{
    return {kL, kR, kLFE, kLs, kRs};
}

ChannelLayout Create_L_R_Ls_Rs_LFE_ChannelLayout()
{
    return {kL, kR, kLs, kRs, kLFE};
}

ChannelLayout Create_C_L_R_Ls_Rs_Cs_ChannelLayout()
{
    return {kC, kL, kR, kLs, kRs, kCs};
}

ChannelLayout Create_C_L_R_Ls_Rs_LFE_ChannelLayout()
{
    return {kC, kL, kR, kLs, kRs, kLFE};
}

ChannelLayout Create_L_C_R_Ls_Rs_LFE_ChannelLayout()
{
    return {kL, kC, kR, kLs, kRs, kLFE};
}

ChannelLayout Create_L_R_Ls_Rs_C_Lc_Rc_ChannelLayout()
{
    return {kL, kR, kLs, kRs, kC, kLc, kRc};
}

ChannelLayout Create_C_L_R_Ls_Rs_Cs_LFE_ChannelLayout()
{
    return {kC, kL, kR, kLs, kRs, kCs, kLFE};
}

ChannelLayout Create_L_R_C_LFE_Ls_Rs_Cs_ChannelLayout()
{
    return {kL, kR, kC, kLFE, kLs, kRs, kCs};
}

ChannelLayout Create_C_L_R_Ls_Rs_Rls_Rrs_ChannelLayout()
{
    return {kC, kL, kR, kLs, kRs, kRls, kRrs};
}

ChannelLayout Create_L_R_Ls_Rs_C_Rls_Rrs_ChannelLayout()
{
    return {kL, kR, kLs, kRs, kC, kRls, kRrs};
}

ChannelLayout Create_C_L_R_Ls_Rs_Rls_Rrs_Cs_ChannelLayout()
{
    return {kC, kL, kR, kLs, kRs, kRls, kRrs, kCs};
}

} // namespace zebmediatypes
