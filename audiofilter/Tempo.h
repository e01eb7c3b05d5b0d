// Musical time, as a host tells it.
#pragma once

namespace zebaudiofilterhost::utility
{

/// What IAudioFilterHost::GetTempo fills. Callers zero it first, so a host may leave out what it does not know.
struct Tempo
{
    int mReserved = 0;       ///< Not read
    double mTempo = 0.0;     ///< Beats per minute
    int mDenominator = 0;    ///< Of the time signature
    int mNumerator = 0;      ///< Of the time signature
    double mReserved2 = 0.0; ///< Not read
};

} // namespace zebaudiofilterhost::utility
