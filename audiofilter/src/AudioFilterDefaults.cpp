// What a filter does where its technology has nothing to say.
#include "audiofilter/AudioFilter.h"

#include <limits>

namespace zebaudiofilterhost
{

int AudioFilter::GetMaxProcessingBlockSize() const
{
    return std::numeric_limits<int>::max();
}

void AudioFilter::SetCurrentOffset(long long)
{
}

bool AudioFilter::IsOfflineProcess() const
{
    return false;
}

bool AudioFilter::CanChangeDuration() const
{
    return false;
}

bool AudioFilter::IsGenerator() const
{
    return false;
}

double AudioFilter::GetProcessedDuration() const
{
    return mCurrentDuration;
}

double AudioFilter::GetProcessedPosition(double position) const
{
    return position;
}

double AudioFilter::GetOriginalPosition(double position) const
{
    return position;
}

double AudioFilter::GetProcessedScale() const
{
    return 1.0;
}

int AudioFilter::GetMaxOutputBlockSize(int) const
{
    return 0;
}

unsigned int AudioFilter::GetTail() const
{
    return 0;
}

int AudioFilter::OfflineProcess(float**, float**, int, int, int)
{
    return 0;
}

bool AudioFilter::OfflineProcessFinished()
{
    return true;
}

void AudioFilter::SetDoSpectral(bool)
{
}

void AudioFilter::SetPreviewMode(bool)
{
}

int AudioFilter::GetCustomData(int, unsigned long, std::vector<float>&)
{
    return 0;
}

int AudioFilter::GetCustomData(int, unsigned long, std::vector<double>&)
{
    return 0;
}

int AudioFilter::GetInitialDelay() const
{
    return 0;
}

void AudioFilter::RequestIOConfiguration(const std::vector<ChannelLayout>&, const std::vector<ChannelLayout>&)
{
}

bool AudioFilter::HasCustomEditor() const
{
    return false;
}

boost::intrusive_ptr<AudioFilterEditor> AudioFilter::CreateCustomEditor()
{
    return {};
}

bool AudioFilter::IsProxy() const
{
    return false;
}

boost::intrusive_ptr<AudioFilterDescriptor> AudioFilter::CreateFilterDescriptor(const PluginLocator&, bool)
{
    return {};
}

} // namespace zebaudiofilterhost
