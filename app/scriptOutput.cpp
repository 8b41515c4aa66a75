#include <boost/python.hpp>

#include "scriptOutput.h"

#include <algorithm>
#include <utility>

namespace bp = boost::python;

namespace Velmora
{

namespace
{

using Kind = LogLine::Kind;

/// The time that lines may wait before they are told of again.
constexpr std::chrono::milliseconds patience(50);

/// In bytes. A longer line is cut into several.
constexpr std::size_t maxLine = 4000;

/// The streams copy what goes into their buffers, so that nothing has to be flushed for the log.
constexpr char const* tapText = R"(
import codecs, io, sys

def tap(name, feed):
    stream = getattr(sys, name)
    if codecs.lookup(stream.encoding).name != 'utf-8':
        decode = codecs.getincrementaldecoder(stream.encoding)('replace').decode
        feedText, feed = feed, lambda data: feedText(decode(bytes(data)).encode('utf-8', 'replace'))
    base = type(stream.buffer)

    class Tapped(base):
        def write(self, data):
            count = base.write(self, data)
            feed(data)
            return count

    encoding, errors, lineBuffering, mode = stream.encoding, stream.errors, stream.line_buffering, stream.mode
    buffer = stream.detach()
    if base is io.FileIO:
        tapped = Tapped(buffer.fileno(), 'wb', closefd=False)
        tapped.name = buffer.name
    else:
        tapped = Tapped(buffer.detach())
    stream = io.TextIOWrapper(tapped, encoding, errors, '\n', lineBuffering, write_through=True)
    stream.mode = mode
    setattr(sys, name, stream)
    setattr(sys, '__%s__' % name, stream)

tap('stdout', feedOutput)
tap('stderr', feedError)
)";

template <Kind kind> PyObject* feed(PyObject* output, PyObject* data)
{
    Py_buffer bytes{};
    if (PyObject_GetBuffer(data, &bytes, PyBUF_SIMPLE) != 0)
        return nullptr;
    static_cast<ScriptOutput*>(PyCapsule_GetPointer(output, nullptr))
        ->add(kind, {static_cast<char const*>(bytes.buf), static_cast<std::size_t>(bytes.len)});
    PyBuffer_Release(&bytes);
    Py_RETURN_NONE;
}

template <Kind kind> bp::object makeFeed(bp::object const& output)
{
    static PyMethodDef definition{"feed", &feed<kind>, METH_O, nullptr};
    return bp::object(bp::handle<>(PyCFunction_New(&definition, output.ptr())));
}

/// The length of the part of a text that fits into a line without cutting a character in two.
std::size_t findCut(std::string_view text, std::size_t room)
{
    if (text.size() <= room)
        return text.size();
    constexpr std::size_t longestCharacter = 4;
    std::size_t cut = room;
    while (cut > 0 && room - cut < longestCharacter && (static_cast<unsigned char>(text[cut]) & 0xc0U) == 0x80U)
        --cut;
    return cut;
}

} // namespace

void ScriptOutput::tapStreams()
{
    bp::object const self(bp::handle<>(PyCapsule_New(this, nullptr, nullptr)));
    bp::dict names;
    names["feedOutput"] = makeFeed<Kind::Output>(self);
    names["feedError"] = makeFeed<Kind::Error>(self);
    bp::exec(tapText, names);
}

void ScriptOutput::add(Kind kind, std::string_view bytes)
{
    bool isNews = false;
    {
        std::lock_guard<std::mutex> const lock(_mutex);
        append(kind, bytes);
        auto const now = std::chrono::steady_clock::now();
        isNews = !std::exchange(_waiting, true) || now - _told > patience;
        if (isNews)
            _told = now;
    }
    if (isNews && _onArrival)
        _onArrival();
}

std::deque<LogLine> ScriptOutput::take()
{
    std::lock_guard<std::mutex> const lock(_mutex);
    std::deque<LogLine> taken;
    taken.swap(_lines);
    if (!taken.empty() && taken.back().isOpen)
        _lines.push_back(taken.back());
    _waiting = false;
    return taken;
}

void ScriptOutput::append(Kind kind, std::string_view bytes)
{
    while (!bytes.empty())
    {
        std::size_t const end = std::min(bytes.find_first_of("\r\n"), bytes.size());
        appendPart(kind, bytes.substr(0, end));
        if (end == bytes.size())
            return;
        _startsAnew = bytes[end] == '\r';
        if (!_startsAnew)
            findOpenLine(kind).isOpen = false;
        bytes.remove_prefix(end + 1);
    }
}

void ScriptOutput::appendPart(Kind kind, std::string_view part)
{
    while (!part.empty())
    {
        LogLine& line = findOpenLine(kind);
        if (std::exchange(_startsAnew, false))
            line.text.clear();
        std::size_t const cut = findCut(part, maxLine - line.text.size());
        line.text += part.substr(0, cut);
        part.remove_prefix(cut);
        line.isOpen = part.empty();
    }
}

LogLine& ScriptOutput::findOpenLine(Kind kind)
{
    if (_lines.empty() || !_lines.back().isOpen || _lines.back().kind != kind)
    {
        if (!_lines.empty())
            _lines.back().isOpen = false;
        _lines.push_back({kind, std::chrono::system_clock::now(), {}, true});
        if (_lines.size() > logLength)
            _lines.pop_front();
    }
    return _lines.back();
}

} // namespace Velmora
