"""Reads the table of rooms in docs/architecture.md and holds every #include of the tree against it.

A row names one or more folders, each a room of its own with everything below it that has no row. In the column "may use"
`Folder/` allows the headers of that room, `<header>` (with * for any letters) those of a library, "the operating system"
the headers below, "all" every room and "any library" every library. A room may always use itself and the standard library.
"""

import fnmatch
import pathlib
import re
import typing

STANDARD = {'cxxabi.h'}  # comes with the standard library, under a name of its own
OPERATING_SYSTEM = {
    'fcntl.h', 'langinfo.h', 'locale.h', 'netdb.h', 'poll.h', 'spawn.h', 'syslog.h', 'termios.h', 'time.h', 'unistd.h',
    'netinet/*', 'sys/*'}

INCLUDE = re.compile(r'\s*#\s*include\s*(["<])([^">]+)[">]')


class Room(typing.NamedTuple):
    folder: str  # ends with a slash
    rooms: frozenset
    headers: frozenset  # patterns
    uses_all: bool


class Wrong(typing.NamedTuple):
    file: str
    line: int
    problem: str

    def __str__(self):
        return f'{self.file}:{self.line}: {self.problem}'


def read_rooms(document):
    """The rooms of the table in the order of its rows, by folder."""
    rooms = {}
    for line in document.splitlines():
        cells = [cell.strip() for cell in line.strip().strip('|').split('|')]
        folders = re.findall(r'`([\w/]+/)`', cells[0]) if line.startswith('| `') and len(cells) == 3 else []
        for folder in folders:
            if folder in rooms:
                raise ValueError(f'{folder} stands twice in the table of rooms')
            rooms[folder] = read_room(folder, cells[2])
    for room in rooms.values():
        for used in room.rooms - rooms.keys():
            raise ValueError(f'{room.folder} may use {used}, which has no row')
    return rooms


def read_room(folder, may_use):
    headers = set(re.findall(r'`<([^>]+)>`', may_use))
    if 'the operating system' in may_use:
        headers |= OPERATING_SYSTEM
    if 'any library' in may_use:
        headers.add('*')
    return Room(folder, frozenset(re.findall(r'`([\w/]+/)`', may_use)), frozenset(headers),
                re.search(r'\ball\b', may_use) is not None)


def used_before_they_stand(rooms):
    """Pairs of a room and one that it may use although that stands further down: without any there is no ring."""
    order = list(rooms)
    return [(room.folder, used) for room in rooms.values() for used in sorted(room.rooms)
            if order.index(used) >= order.index(room.folder)]


def room_of(rooms, path):
    """The room with the longest folder that the path begins with, or None."""
    return max((room for room in rooms.values() if path.startswith(room.folder)),
               key=lambda room: len(room.folder), default=None)


def problem_of(rooms, room, quote, header, is_there):
    """What is wrong with one include, or None."""
    if quote == '<':
        is_standard = re.fullmatch(r'[a-z_0-9]+', header) or header in STANDARD
        if is_standard or any(fnmatch.fnmatchcase(header, pattern) for pattern in room.headers):
            return None
        return f'{room.folder} may not use the library of <{header}>'
    used = room_of(rooms, header)
    if used is None:
        return f'"{header}" is in no room: an include gives the path from the top of the tree'
    if not is_there(header):
        return f'"{header}" does not exist'
    if used is room or room.uses_all or used.folder in room.rooms:
        return None
    return f'{room.folder} may not use {used.folder} ("{header}")'


def check_file(rooms, path, text, is_there):
    """The wrong includes of one file of the tree."""
    room = room_of(rooms, path)
    if room is None:
        return [Wrong(path, 1, 'is in no room of docs/architecture.md')]
    found = []
    for number, line in enumerate(text.splitlines(), 1):
        include = INCLUDE.match(line)
        problem = include and problem_of(rooms, room, include[1], include[2], is_there)
        if problem:
            found.append(Wrong(path, number, problem))
    return found


def sources(top):
    """Every source and header of the tree, but not what builds have left."""
    for folder in sorted(top.iterdir()):
        if folder.is_dir() and folder.name != 'build' and not folder.name.startswith('.'):
            yield from sorted(path for path in folder.rglob('*') if path.suffix in ('.cpp', '.h'))


def check_tree(top):
    top = pathlib.Path(top)
    rooms = read_rooms((top / 'docs/architecture.md').read_text(encoding='utf-8'))
    found = []
    for path in sources(top):
        found += check_file(rooms, str(path.relative_to(top)), path.read_text(encoding='utf-8'),
                            lambda header: (top / header).is_file())
    return found
