// The command line program `kestrel`.

#include <cstdio>
#include <exception>
#include <new>

#include "apps/kestrel/CommandLine.h"
#include "apps/kestrel/ProgramError.h"
#include "kestrel/foundation/KestrelException.h"
#include "kestrel/foundation/Locale.h"
#include "kestrel/platform/Terminal.h"

namespace {

int Fail(kestrel_program::ExitCode code, const char* text) {
  std::fprintf(stderr, "kestrel: %s\n", text);
  return code;
}

}  // namespace

int main(int argc, char** argv) {
  try {
    MCKestrel_800::PrepareStandardStreams();
    MCKestrel_800::IgnoreLibrariesOfCurrentFolder();
    // Documents, tables and file names are UTF-8 on every system, whatever code page the process has.
    MCXML_800::SetUTF8mode(1);
    return kestrel_program::RunCommandLine(MCKestrel_800::GetUtf8Arguments(argc, argv));
  } catch (const kestrel_program::ProgramError& fault) {
    return Fail(fault.GetCode(), fault.GetText().c_str());
  } catch (const MCKestrel_800::KestrelException& fault) {
    return Fail(kestrel_program::kDocument, fault.GetErrorMessage().c_str());
  } catch (const std::bad_alloc&) {
    return Fail(kestrel_program::kInputOutput, "the memory does not suffice");
  } catch (const std::exception& fault) {
    return Fail(kestrel_program::kInputOutput, fault.what());
  } catch (...) {
    return Fail(kestrel_program::kInputOutput, "something failed without saying why");
  }
}
