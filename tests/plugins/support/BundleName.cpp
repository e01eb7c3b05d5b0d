namespace fixture
{

extern const char* const kBundleName;
const char* const kBundleName = ZEB_BUNDLE;

} // namespace fixture
