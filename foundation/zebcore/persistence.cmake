# Property lists, files, XML, console and binary text; paths from foundation/.

if(APPLE)
    set(ZEB_PERSISTENCE_PLATFORM mac)
else()
    set(ZEB_PERSISTENCE_PLATFORM linux)
endif()

set(ZEB_PERSISTENCE_SOURCES
    zebcore/AbstractParseHandler.cpp
    zebcore/BinaryText.cpp
    zebcore/Command.cpp
    zebcore/CommandRegistry.cpp
    zebcore/Dir.cpp
    zebcore/DirIterator.cpp
    zebcore/File.cpp
    zebcore/FileDescriptor.cpp
    zebcore/FileExceptions.cpp
    zebcore/FileStatus.cpp
    zebcore/FileSystemCalls.cpp
    zebcore/FileUtils.cpp
    zebcore/IPlatformByteStream.cpp
    zebcore/NativePath.cpp
    zebcore/ParseXml.cpp
    zebcore/Paths.cpp
    zebcore/PositionTable.cpp
    zebcore/PropList.cpp
    zebcore/PropListEntries.cpp
    zebcore/PropListReader.cpp
    zebcore/PropListUtils.cpp
    zebcore/PropListVisitor.cpp
    zebcore/PropListWriter.cpp
    zebcore/SafeSave.cpp
    zebcore/TempFiles.cpp
    zebcore/TextFile.cpp
    zebcore/XmlParser.cpp
    zebcore/XmlText.cpp
    zebcore/XmlUtils.cpp
    zebcore/${ZEB_PERSISTENCE_PLATFORM}/CompareFileNames.cpp
    zebcore/${ZEB_PERSISTENCE_PLATFORM}/PlatformFiles.cpp)

set(ZEB_PERSISTENCE_HEADERS
    zebcore/AbstractParseHandler.h
    zebcore/BinaryText.h
    zebcore/Command.h
    zebcore/CommandRegistry.h
    zebcore/CompareFileNames.h
    zebcore/Dir.h
    zebcore/File.h
    zebcore/FileExceptions.h
    zebcore/FileUtils.h
    zebcore/IPlatformByteStream.h
    zebcore/NativePath.h
    zebcore/PropList.h
    zebcore/PropListUtils.h
    zebcore/PropListVisitor.h
    zebcore/SafeSave.h
    zebcore/XmlParser.h
    zebcore/XmlUtils.h)
