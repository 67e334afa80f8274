// The two calls into the operating system that the framework cannot make in standard C++: the
// dynamic loader and the system's opener of documents. One source file per platform.
#pragma once

#include <string>
#include <string_view>
#include <vector>

// Only the standard library here: the Windows source includes the system's own headers beside it.
namespace framework::platform {

using Function = void (*)();

// The file names a library name is looked for as, most specific first.
std::vector<std::string> LibraryFileNames(std::string_view name);
// The folder separator of file paths.
char PathSeparator();
// A loaded library's native handle, or null.
void* OpenLibrary(const std::string& path);
Function FindSymbol(void* library, const std::string& name);
void CloseLibrary(void* library);

// Hands a document to the program the system opens it with; true when it took the request.
bool OpenWithSystem(const std::string& file, const std::string& parameters, const std::string& directory, int show);

}  // namespace framework::platform
