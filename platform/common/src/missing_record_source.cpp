#include "ryx/common/missing_record_source.h"

#include "ryx/errors.h"

namespace ryx::common {

void MissingRecordSource::fail() const {
    throw DataSourceError("cannot open database \"" + name_ +
                          "\": no database engine is set up for this form");
}

}  // namespace ryx::common
