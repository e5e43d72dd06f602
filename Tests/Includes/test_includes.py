import pathlib
import tempfile
import unittest

import includes

TOP = pathlib.Path(__file__).resolve().parents[2]

TABLE = '''
| folder | holds | may use |
|---|---|---|
| `Ground/` | values | standard library; the operating system |
| `Ground/Parser/` | reads them | `Ground/`; expat (`<expat.h>`) |
| `Left/`, `Right/` | two that know nothing of each other | `Ground/` |
| `Top/` | the programs | all; Qt (`<Q*>`) |
| `Checks/` | evidence | all; any library |
'''


class TheTree(unittest.TestCase):
    def test_includes_only_what_its_rooms_may_use(self):
        wrong = includes.check_tree(TOP)
        self.assertFalse(wrong, '\n' + '\n'.join(map(str, wrong)))

    def test_has_rooms_that_use_only_what_stands_above_them(self):
        rooms = includes.read_rooms((TOP / 'docs/architecture.md').read_text(encoding='utf-8'))
        self.assertEqual(includes.used_before_they_stand(rooms), [])

    def test_gives_the_systems_own_folders_no_library(self):
        rooms = includes.read_rooms((TOP / 'docs/architecture.md').read_text(encoding='utf-8'))
        own = [room for room in rooms.values()
               if room.folder.startswith(('LogGenerator/', 'Sections/', 'Monitor/')) or room.folder == 'UI/']
        self.assertGreater(len(own), 6)
        for room in own:
            self.assertFalse(room.headers | ({'all'} if room.uses_all else set()), room.folder)


class AnInclude(unittest.TestCase):
    def problems(self, path, *lines):
        rooms = includes.read_rooms(TABLE)
        return [str(wrong) for wrong in includes.check_file(rooms, path, '\n'.join(lines), lambda _: True)]

    def test_of_the_same_room_the_room_below_or_the_standard_library_is_right(self):
        self.assertEqual(self.problems('Left/Deep/A.cpp', '#include "Left/B.h"', '#include "Ground/Value.h"',
                                       '#include <string_view>', '#include <cxxabi.h>'), [])

    def test_of_a_room_beside_or_above_is_noticed_with_file_and_line(self):
        self.assertEqual(self.problems('Left/A.cpp', '#include "Left/A.h"', '', '#include "Right/B.h"'),
                         ['Left/A.cpp:3: Left/ may not use Right/ ("Right/B.h")'])
        self.assertEqual(self.problems('Ground/A.h', '  # include "Top/Main.h"'),
                         ['Ground/A.h:1: Ground/ may not use Top/ ("Top/Main.h")'])

    def test_of_a_room_inside_another_is_held_against_its_own_row(self):
        self.assertEqual(self.problems('Left/A.cpp', '#include "Ground/Parser/Parser.h"'),
                         ['Left/A.cpp:1: Left/ may not use Ground/Parser/ ("Ground/Parser/Parser.h")'])

    def test_of_a_library_is_right_only_where_the_table_names_it(self):
        self.assertEqual(self.problems('Ground/Parser/A.cpp', '#include <expat.h>'), [])
        self.assertEqual(self.problems('Ground/A.cpp', '#include <expat.h>'),
                         ['Ground/A.cpp:1: Ground/ may not use the library of <expat.h>'])
        self.assertEqual(self.problems('Top/A.cpp', '#include <QTimer>', '#include <CLI/CLI.hpp>'),
                         ['Top/A.cpp:2: Top/ may not use the library of <CLI/CLI.hpp>'])
        self.assertEqual(self.problems('Checks/A.cpp', '#include <gtest/gtest.h>', '#include "Right/B.h"'), [])

    def test_of_the_operating_system_is_right_only_where_the_table_says_so(self):
        self.assertEqual(self.problems('Ground/A.cpp', '#include <unistd.h>', '#include <sys/stat.h>'), [])
        self.assertEqual(len(self.problems('Left/A.cpp', '#include <unistd.h>', '#include <sys/stat.h>')), 2)

    def test_without_the_path_from_the_top_is_noticed(self):
        self.assertIn('is in no room', self.problems('Left/A.cpp', '#include "A.h"')[0])

    def test_of_a_file_that_does_not_exist_is_noticed(self):
        rooms = includes.read_rooms(TABLE)
        wrong = includes.check_file(rooms, 'Left/A.cpp', '#include "Left/Gone.h"', lambda _: False)
        self.assertEqual([str(each) for each in wrong], ['Left/A.cpp:1: "Left/Gone.h" does not exist'])


class ATable(unittest.TestCase):
    def test_with_a_ring_is_noticed(self):
        rooms = includes.read_rooms('| `A/` | a | `B/` |\n| `B/` | b | `A/` |')
        self.assertEqual(includes.used_before_they_stand(rooms), [('A/', 'B/')])

    def test_that_names_a_room_without_a_row_or_twice_is_refused(self):
        for table in '| `A/` | a | `B/` |', '| `A/` | a | – |\n| `A/` | a | – |':
            with self.assertRaises(ValueError):
                includes.read_rooms(table)


class ATreeOfFiles(unittest.TestCase):
    def test_shows_its_wrong_include_and_its_file_outside_the_rooms(self):
        with tempfile.TemporaryDirectory() as folder:
            top = pathlib.Path(folder)
            for path, text in {
                    'docs/architecture.md': TABLE,
                    'Left/A.cpp': '#include "Right/B.h"\n',
                    'Right/B.h': '#include <vector>\n',
                    'Attic/C.cpp': '',
                    'build/Left/D.cpp': '#include "Right/B.h"\n'}.items():
                (top / path).parent.mkdir(parents=True, exist_ok=True)
                (top / path).write_text(text, encoding='utf-8')
            self.assertEqual([(wrong.file, wrong.line) for wrong in includes.check_tree(top)],
                             [('Attic/C.cpp', 1), ('Left/A.cpp', 1)])


if __name__ == '__main__':
    unittest.main()
