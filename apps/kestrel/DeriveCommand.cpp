#include "apps/kestrel/DeriveCommand.h"

#include "apps/kestrel/DerivedColumns.h"
#include "apps/kestrel/LoadedModel.h"

namespace kestrel_program {

ExitCode Derive(const DeriveOptions& options) {
  RefuseClashes(options.table, "the document");
  DerivedColumns columns(LoadFields(options.table.document), options.fields);
  return TableRun(options.table, columns).Run();
}

}  // namespace kestrel_program
