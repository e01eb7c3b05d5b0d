# Bundles that hold nothing this machine can load. A few bytes each, written at configuration.
set(fixtures ${PROJECT_BINARY_DIR}/fixtures)

# Only a binary for another system, only one for another processor.
file(WRITE ${fixtures}/WindowsOnly.vst3/Contents/x86_64-win/WindowsOnly.vst3 "MZ")
file(WRITE ${fixtures}/OtherArchitecture.vst3/Contents/aarch64-linux/OtherArchitecture.so "ELF")

# A binary in the right place that is none, and one whose header says that it is for another processor.
file(WRITE ${fixtures}/NotABinary.vst3/Contents/${CMAKE_SYSTEM_PROCESSOR}-linux/NotABinary.so "text\n")
set(foreign ${fixtures}/ForeignBinary.vst3/Contents/${CMAKE_SYSTEM_PROCESSOR}-linux)
file(MAKE_DIRECTORY ${foreign})
string(REPEAT "\\0" 8 zeros)
execute_process(OUTPUT_FILE ${foreign}/ForeignBinary.so COMMAND_ERROR_IS_FATAL ANY COMMAND
    printf "\\177ELF\\2\\1\\1\\0${zeros}\\3\\0\\267\\0\\1\\0\\0\\0${zeros}${zeros}${zeros}${zeros}\\100\\0${zeros}\\0\\0")

# A folder with nothing in it, and a file where a folder is wanted.
file(MAKE_DIRECTORY ${fixtures}/EmptyBundle.vst3)
file(WRITE ${fixtures}/PlainFile.vst3 "text\n")
