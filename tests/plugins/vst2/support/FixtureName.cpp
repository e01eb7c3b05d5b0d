// Compiled once for each fixture, so that it includes nothing.
namespace vst2fixture
{

extern const char* const kFixtureName;
const char* const kFixtureName = ZEB_TITLE;

} // namespace vst2fixture
