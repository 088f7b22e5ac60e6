#include "import/cad/module/CadDocument.h"

#include "import/cad/module/CadProgress.h"
#include "import/files/FileEnd.h"

#include <BRepTools.hxx>
#include <BRep_Builder.hxx>
#include <BinTools.hxx>
#include <IGESCAFControl_Reader.hxx>
#include <Interface_Static.hxx>
#include <STEPCAFControl_Reader.hxx>
#include <TopoDS_Shape.hxx>
#include <XCAFApp_Application.hxx>
#include <XCAFDoc_DocumentTool.hxx>
#include <XCAFDoc_ShapeTool.hxx>

#include <algorithm>
#include <istream>
#include <streambuf>
#include <string_view>

namespace quarn {

namespace {

constexpr double SHARE_OF_READING = 0.5; ///< the rest goes to the meshes

/// The library reads streams; the bytes are in memory.
class ByteStream : std::streambuf, public std::istream {
public:
    explicit ByteStream(std::span<const std::uint8_t> bytes)
        : std::istream(static_cast<std::streambuf*>(this)) {
        char* const begin = const_cast<char*>(reinterpret_cast<const char*>(bytes.data()));
        setg(begin, begin, begin + bytes.size()); // which are only read
    }

private:
    std::streambuf::pos_type seekoff(std::streambuf::off_type offset, std::ios_base::seekdir from,
                                     std::ios_base::openmode) override {
        char* const base = from == std::ios_base::beg   ? eback()
                           : from == std::ios_base::cur ? gptr()
                                                        : egptr();
        if (offset < eback() - base || offset > egptr() - base)
            return std::streambuf::pos_type(std::streambuf::off_type(-1));
        setg(eback(), base + offset, egptr());
        return gptr() - eback();
    }
    std::streambuf::pos_type seekpos(std::streambuf::pos_type position,
                                     std::ios_base::openmode mode) override {
        return seekoff(std::streambuf::off_type(position), std::ios_base::beg, mode);
    }
};

Handle(TDocStd_Document) newDocument() {
    Handle(TDocStd_Document) document;
    XCAFApp_Application::GetApplication()->NewDocument("BinXCAF", document);
    XCAFDoc_ShapeTool::SetAutoNaming(false); // "SOLID" names nothing
    return document;
}

bool readStepInto(const ModelReading& reading, Handle(TDocStd_Document) & document,
                  const Message_ProgressRange& progress) {
    Interface_Static::SetCVal("xstep.cascade.unit", "MM");
    STEPCAFControl_Reader reader;
    reader.SetColorMode(true);
    reader.SetNameMode(true);
    ByteStream stream(reading.bytes);
    return reader.ChangeReader().ReadStream(reading.path.filename().c_str(), stream) ==
               IFSelect_RetDone &&
           reader.Transfer(document, progress);
}

bool readIgesInto(const ModelReading& reading, Handle(TDocStd_Document) & document,
                  const Message_ProgressRange& progress) {
    Interface_Static::SetCVal("xstep.cascade.unit", "MM");
    IGESCAFControl_Reader reader;
    reader.SetColorMode(true);
    reader.SetNameMode(true);
    return reader.ReadFile(reading.path.c_str()) == IFSelect_RetDone &&
           reader.Transfer(document, progress);
}

bool readBrepInto(const ModelReading& reading, Handle(TDocStd_Document) & document,
                  const Message_ProgressRange& progress) {
    constexpr std::size_t LONGEST_HEAD = 200;
    const std::string_view head(reinterpret_cast<const char*>(reading.bytes.data()),
                                std::min(reading.bytes.size(), LONGEST_HEAD));
    const bool is_binary = head.find("Open CASCADE Topology") != std::string_view::npos;
    if (!is_binary && head.find("CASCADE Topology") == std::string_view::npos)
        return false; // the library would say so on the person's terminal
    TopoDS_Shape shape;
    ByteStream stream(reading.bytes);
    if (is_binary)
        BinTools::Read(shape, stream, progress);
    else
        BRepTools::Read(shape, stream, BRep_Builder(), progress);
    if (shape.IsNull())
        return false;
    XCAFDoc_DocumentTool::ShapeTool(document->Main())->AddShape(shape, true);
    return true;
}

/// The last line of an IGES file has a T in column 73.
bool endsAsIges(std::string_view end) {
    constexpr std::size_t SECTION_COLUMN = 72;
    const std::size_t last = end.find_last_not_of("\r\n \0");
    const std::size_t line = end.find_last_of('\n', last);
    const std::size_t begin = line == std::string_view::npos ? 0 : line + 1;
    return last != std::string_view::npos && last >= begin + SECTION_COLUMN &&
           end[begin + SECTION_COLUMN] == 'T';
}

} // namespace

Result<Handle(TDocStd_Document)> readCadDocument(const ModelReading& reading, CadFormat format) {
    Handle(TDocStd_Document) document = newDocument();
    Handle(CadProgress) progress = new CadProgress(reading.watch, 0.0, SHARE_OF_READING);
    const auto read = format == CadFormat::step   ? readStepInto
                      : format == CadFormat::iges ? readIgesInto
                                                  : readBrepInto;
    const bool is_read = read(reading, document, progress->Start());
    if (progress->UserBreak())
        return Error{"it was given up"};
    if (!is_read)
        return Error{"it is damaged, or no such file whatever its name says"};
    return document;
}

std::string cutOffText(const ModelReading& reading, CadFormat format) {
    const std::string_view end = endOfFile(reading.bytes);
    const bool is_whole =
        format == CadFormat::brep ||
        (format == CadFormat::iges ? endsAsIges(end)
                                   : end.find("END-ISO") != std::string_view::npos);
    return is_whole ? "" : CUT_OFF_TEXT;
}

} // namespace quarn
