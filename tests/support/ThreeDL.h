#pragma once

#include "lut/io/LUTFileReader.h"
#include "lut/io/LUTFileWriter.h"
#include "lut/property/PropertySet.h"

namespace test {

/// Sets a property of one value on a reader or writer.
template <class Kind, class Face, class Value>
void setProperty(Face& face, const std::string& name, const Value& value) {
    face.setProperty(name, Orlith::Property::makeProperty<Kind>(name, value));
}

/// What a .3dl reader has to be told; by default it goes by the file.
struct Reading3DL {
    const char* format = "auto";
    int outputBits = -2;
    int normalizeOutput = 0;

    void operator()(Orlith::LUT::LUTFileReader& reader) const {
        setProperty<Orlith::Property::String>(reader, "format3DL", format);
        setProperty<Orlith::Property::Int>(reader, "outputBitDepth", outputBits);
        setProperty<Orlith::Property::Int>(reader, "normalizeOutput", normalizeOutput);
    }
};

/// What a .3dl writer has to be told. Scratch's codes are scaled and offset, as its programs do.
struct Writing3DL {
    const char* format = nullptr;
    int inputBits = 10;
    int outputBits = 12;
    int clampOutput = 1;

    void operator()(Orlith::LUT::LUTFileWriter& writer) const {
        setProperty<Orlith::Property::String>(writer, "format3DL", format);
        setProperty<Orlith::Property::Int>(writer, "inputBitDepth", inputBits);
        setProperty<Orlith::Property::Int>(writer, "outputBitDepth", outputBits);
        setProperty<Orlith::Property::Int>(writer, "clampOutput", clampOutput);
        if (std::string_view(format) != "scratch") return;
        setProperty<Orlith::Property::Double>(writer, "scale", 0.9797979593276978);  // 97/99
        setProperty<Orlith::Property::Double>(writer, "offset", 15.0);
    }
};

}  // namespace test
