#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "lut/LUT.h"
#include "lut/property/PropertySet.h"

namespace Orlith::LUT {

/// Writes a table to a file; one kind of writer for each format.
/// Binary  the order of the virtual functions is fixed: new ones go last.
class LUTFileWriter {
public:
    LUTFileWriter() = default;
    LUTFileWriter(const LUTFileWriter&) = delete;
    LUTFileWriter& operator=(const LUTFileWriter&) = delete;
    virtual ~LUTFileWriter() = default;

    /// Writes the table, replacing a file of that name. What goes wrong after the file was opened
    /// (a full disk) is no exception: see wroteAll.
    /// @throws Exception  the format cannot hold this table, or the file cannot be opened
    virtual void write(const std::string& filename, const boost::shared_ptr<LUT>& lut) = 0;

    /// Options of the format. A name that is taken keeps its property; the result says so by false.
    ///
    /// All text formats know "flushLines" (Int, 1 when absent): 1 hands every line to the system
    /// when it is complete, 0 gathers lines into large blocks. All formats know "interchange" (Int,
    /// 0 when absent): 0 goes by the letter of the format, 1 writes what other programs read as
    /// this table's look.
    bool setProperty(const std::string& name, const boost::shared_ptr<Property::Base>& property) {
        return properties_.insert(name, property);
    }

    /// After write: whether the system took every byte, the closing of the file included. False
    /// before the first write.
    bool wroteAll() const { return wroteAll_; }

protected:
    const Property::PropertySet& properties() const { return properties_; }

    /// The value of "flushLines".
    bool flushesLines() const { return flag("flushLines", true); }

    /// The value of "interchange".
    bool isInterchange() const { return flag("interchange", false); }

private:
    bool flag(const char* name, bool whenAbsent) const {
        const auto property = properties_.find(name);
        const auto* value = Property::asInt(property.get(), 1);
        return value == nullptr ? whenAbsent : value->values[0] != 0;
    }

    Property::PropertySet properties_;

protected:
    bool wroteAll_ = false;
};

}  // namespace Orlith::LUT
