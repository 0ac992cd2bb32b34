#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <string>
#include <vector>

#include "lut/LUT.h"
#include "lut/io/Remarks.h"
#include "lut/property/PropertySet.h"

namespace Orlith::LUT {

/// A read that is under way.
struct Reading {
    bool isMeant;  ///< as other programs mean the file; false: by the book
    Remarks& remarks;
    const std::uint64_t& lineNumber;
    const std::uint64_t& sampleCount;
    const boost::shared_ptr<LUT>& table;  ///< the reader's current one
};

/// Reads a table from a file; one kind of reader for each format. A reader can be used again.
/// Binary  the order of the virtual functions is fixed: new ones go last.
class LUTFileReader {
public:
    LUTFileReader() = default;
    LUTFileReader(const LUTFileReader&) = delete;
    LUTFileReader& operator=(const LUTFileReader&) = delete;
    virtual ~LUTFileReader() = default;

    /// Reads the named file into a new table, a LUT1D or a LUT3D.
    /// @throws Exception          the file cannot be opened or is not what the format says
    /// @throws std::length_error  the file declares a table that no lattice can hold
    /// @throws std::bad_alloc     the table does not fit into memory
    virtual boost::shared_ptr<LUT> read(const std::string& filename) = 0;

    /// Options of the format. A name that is taken keeps its property; the result says so by false.
    ///
    /// All formats know "interchange" (Int, 0 when absent): 0 goes by the letter of the format, 1
    /// takes what other programs write and gives the table that they mean by it. ".3dl" files, of
    /// which any beginning may be a table, know "fileOrder" as well (Int, 0 when absent): 1 lets
    /// the samples of a table that is not filled stand as they came, for those who look at none of
    /// them. Strewn over a huge lattice few take much memory.
    bool setProperty(const std::string& name, const boost::shared_ptr<Property::Base>& property) {
        return properties_.insert(name, property);
    }

    /// The option of that name, or an empty pointer.
    boost::shared_ptr<Property::Base> getProperty(const std::string& name) const {
        return properties_.find(name);
    }

    /// The physical line that was read last, counted from 1: after a failure, the place of it.
    /// 0 when none was read, and for binary files.
    std::uint64_t lineNumber() const { return lineNumber_; }

    /// Samples of the table that the file held, surplus ones that overwrote others included.
    std::uint64_t sampleCount() const { return sampleCount_; }

    /// What the last read forgave, did not use or stumbled over; after a failure the last one is
    /// its reason in words.
    std::vector<Remark> remarks() const { return remarks_.list(); }

protected:
    const Property::PropertySet& properties() const { return properties_; }

    /// The value of "interchange".
    bool isInterchange() const { return isSet("interchange"); }

    /// Whether a property is an Int other than 0.
    bool isSet(const char* name) const {
        const auto property = properties_.find(name);
        const auto* flag = Property::asInt(property.get(), 1);
        return flag != nullptr && flag->values[0] != 0;
    }

    /// What stands beside the book needs to know of this read.
    Reading reading() { return {isInterchange(), remarks_, lineNumber_, sampleCount_, lut_}; }

    /// Fails because the file cannot be opened, as errno says.
    [[noreturn]] void failToOpen(const char* message);

    /// Forgets the last read: call first in read.
    void beginRead() {
        lineNumber_ = 0;
        sampleCount_ = 0;
        remarks_.clear();
    }

    boost::shared_ptr<LUT> lut_;  ///< the reader's current table

private:
    Property::PropertySet properties_;

protected:
    std::uint64_t lineNumber_ = 0;
    std::uint64_t sampleCount_ = 0;
    Remarks remarks_;
};

}  // namespace Orlith::LUT
