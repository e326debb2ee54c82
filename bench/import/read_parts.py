"""Reads the systems of a model file with zipfile and xml.etree.

    read_parts.py FILE ROUNDS

Prints the seconds of a round: open the archive, unpack and parse each part
below simulink/ with blocks. A first round warms up and does not count.
"""

import sys
import time
import xml.etree.ElementTree
import zipfile


def read(file):
    blocks = 0
    with zipfile.ZipFile(file) as archive:
        for name in archive.namelist():
            if name == "simulink/blockdiagram.xml" or name.startswith(
                    "simulink/systems/"):
                root = xml.etree.ElementTree.fromstring(archive.read(name))
                blocks += len(root.findall("Block"))
    return blocks


rounds = int(sys.argv[2])
count = read(sys.argv[1])
start = time.perf_counter()
for _ in range(rounds):
    read(sys.argv[1])
print(count, (time.perf_counter() - start) / rounds)
