"""Retarget subjects from Python: what relates a performer's skeleton (.qrs) to a character's (FBX).

    import retarget_setup as rs

    session = rs.create(fbx="hero.fbx", source="performer.qrs", edits=["match-file-pose", "auto", "update-targets"])
    session.save("hero.qrr")

    file = rs.read("hero.qrr")
    kinematics = rs.Kinematics(file)
    poses = kinematics.poses(kinematics.bind_pose())    # (segments, 4, 4), millimetres

Positions are in millimetres, rotations angle-axis vectors in radians, matrices row by row for column vectors; Z is up.
What the libraries tell goes to the loggers "retarget_setup.CATEGORY" of logging; what fails raises Error with the same
sentences that the command line prints, and writes nothing. Calls let other threads of Python go on meanwhile.
"""
import dataclasses as _dataclasses
import enum as _enum
import logging as _logging
import os as _os
import re as _re

from . import _core

__version__ = _core.version

#: Parent index of a segment that has no parent.
NO_PARENT = 0xFFFFFFFF
#: A static parameter's value, or one degree of freedom of a T-pose, that is not set.
NOT_SET = 1.7976931348623157e308

# As libraries do: who wants messages says where they go.
_logging.getLogger("retarget_setup").addHandler(_logging.NullHandler())


class Error(Exception):
    """Why something could not be done, in one or more sentences.

    status is what the command line would have returned: 1 findings, 2 wrong usage, 3 input that cannot be read or is
    invalid, 4 output that cannot be written.
    """

    def __init__(self, text, status=3):
        super().__init__(text)
        self.status = status


def _make_classes():
    """The classes of all records and enumerations, from the description that reading and writing come from, too."""
    classes = {}
    for name, meaning, values in _core.describe_enumerations():
        members = [(_re.sub(r"(?<=[a-z])(?=[A-Z])", "_", value).upper(), value) for value in values]
        classes[name] = _enum.Enum(name, members, type=str, module=__name__)
        classes[name].__doc__ = meaning or None

    def field(name, kind, is_record, default):
        if is_record:
            return name, kind, _dataclasses.field(default_factory=classes[kind])
        if isinstance(default, list):
            return name, kind, _dataclasses.field(default_factory=default.copy)
        return name, kind, _dataclasses.field(default=classes[kind](default) if kind in classes else default)

    for name, fields in _core.describe_records():
        made = _dataclasses.make_dataclass(
            name, [field(key, kind, is_record, default) for key, kind, _, is_record, default in fields],
            namespace={"__module__": __name__}, slots=True)
        made.__doc__ = "\n".join(f"{key}: {kind}" + (f": {meaning}" if meaning else "")
                                 for key, kind, meaning, _, _ in fields)
        classes[name] = made
    return classes


_classes = _make_classes()
globals().update(_classes)
_core.register(_classes, Error)


@_dataclasses.dataclass(frozen=True, slots=True)
class Finding:
    """One thing that is wrong with a subject, and how to mend it."""

    element: str
    index: int
    name: str
    message: str
    remedy: str
    tolerated: bool


@_dataclasses.dataclass(frozen=True, slots=True)
class Change:
    """One thing in which two files differ; str() is the sentence for it."""

    id: str
    element: str
    name: str
    field: str
    before: str
    after: str
    millimetres: "float | None"
    degrees: "float | None"
    sentence: str

    def __str__(self):
        return self.sentence


@_dataclasses.dataclass(frozen=True, slots=True, eq=False)
class Bone:
    """A bone of an FBX file. parent is its index, -1 for a root; matrix a numpy array, 4 by 4, in millimetres."""

    name: str
    parent: int
    matrix: object


def _path(path):
    """As the system has it, whether it is text or not."""
    name = _os.fsencode(path)
    if b"\0" in name:
        raise ValueError("a path has a null character in it")
    return name


def _optional_path(path):
    return None if path is None else _path(path)


def _wanted(value, kind):
    """The value, if it is of this class."""
    if not isinstance(value, kind):
        raise TypeError(f"a {kind.__name__} is wanted here, not {type(value).__name__}")
    return value


def _parts(file):
    return _wanted(file, SkeletonFile)._parts()


def _list(words):
    """One word alone is a list of one."""
    return [words] if isinstance(words, str) else list(words)


def _frame(number):
    if number is not None and number < 0:
        raise ValueError("frames count from 0")
    return number


class SkeletonFile:
    """What a file of the skeleton family holds. Subject and application data may be changed at will: nothing is looked
    up before check, write or Kinematics. The lists of segments, markers and targets run parallel in both."""

    __slots__ = ("subject", "application_data", "_extras")

    def __init__(self, subject=None, application_data=None):
        self.subject = subject if subject is not None else _classes["Subject"]()
        self.application_data = application_data if application_data is not None else _classes["ApplicationData"]()
        self._extras = _core.Extras()

    def _parts(self):
        return self.subject, self.application_data, self._extras

    @classmethod
    def _of(cls, parts):
        file = cls(parts[0], parts[1])
        file._extras = parts[2]
        return file

    def write(self, path, version=None):
        """Writes a skeleton file at a version of the format ("3.5"; None: the lowest that holds it). The file that
        stands there is replaced when the whole of the new one stands on disk."""
        _core.write(self._parts(), _path(path), version)

    def check(self):
        """A list of Finding; empty for a well-formed subject."""
        return [Finding(*parts) for parts in _core.check(self._parts())]

    def segment(self, name):
        """The first segment of this name; KeyError if there is none."""
        for segment in self.subject.segments:
            if segment.name == name:
                return segment
        raise KeyError(name)


class Kinematics(_core.Kinematics):
    """Forward kinematics of a file as it is now; later changes of the file change nothing here.

    States are all joints' values in the order of the segments, number_of_states for a frame. Where states of N frames
    are given, (N, number_of_states), results have the frames as their first axis; one row gives one frame.
    """

    def __init__(self, file):
        super().__init__(_parts(file))

    def poses(self, states):
        """World poses of the segments as matrices, (segments, 4, 4)."""
        return super().poses(states)

    def markers(self, states):
        """World positions of the markers, (markers, 3); nan where no target tells one."""
        return super().markers(states)

    def rotations(self, states):
        """World rotations of the rotation observations, (rotations, 3, 3); nan where no target tells one."""
        return super().rotations(states)


class Take(_core.Take):
    """A recorded motion of a performer, from a BVH or FBX file.

    What the file does not tell is guessed, and told as a warning: up is "y" or "z", unit the millimetres of one unit.
    With rate it is brought to so many frames a second; stack names an animation stack of an FBX file.
    """

    def __init__(self, path, stack=None, up=None, unit=None, rate=None):
        super().__init__(_path(path), stack, up, unit, rate)

    def joints(self):
        """Its joints, a list of (name, index of the parent or -1), parents first."""
        return super().joints()

    def joint_poses(self, first=0, last=None):
        """World poses of its joints in the frames from first to last, (frames, joints, 4, 4)."""
        return super().joint_poses(_frame(first), _frame(last))

    def poses(self, source, first=0, last=None, joints=(), rest_frame=None):
        """World poses of a performer's segments who moves by the take, (frames, segments, 4, 4).

        source is the performer's SkeletonFile. Which joint drives which segment is told by names and shapes; joints adds
        (joint, segment) to that. In rest_frame the performer stands as in the bind pose; without it the take's rest pose
        counts.
        """
        return super().poses(_parts(source), _frame(first), _frame(last), list(joints), _frame(rest_frame))

    def performer(self):
        """A performer's skeleton made of the take, as SkeletonFile."""
        return SkeletonFile._of(super().performer())


@_dataclasses.dataclass(frozen=True, slots=True, eq=False)
class Solved:
    """A character that followed a take, frames from first on. Numpy arrays: states (frames, states), for Kinematics;
    residuals (frames, targets), how far each is off, in mm and of rotations in radians, nan for one that is left out;
    iterations and converged (frames,). report is what "retarget solve --json" prints."""

    first: int
    rate: float
    states: "NDArray[np.float64]"
    residuals: "NDArray[np.float64]"
    iterations: "NDArray[np.uint32]"
    converged: "NDArray[np.bool_]"
    report: "dict[str, Any]"


def _edits(edits):
    """Names with or without dashes, alone or with their values."""
    pairs = []
    for edit in _list(edits):
        if not isinstance(edit, str) and (not isinstance(edit, (tuple, list)) or len(edit) != 2):
            raise TypeError(f"an edit is a name, or (name, value), not {edit!r}")
        name, value = (edit, None) if isinstance(edit, str) else edit
        name = name.removeprefix("--")
        pairs.append((name.replace("_", "-"), None if value is None else str(value)))
    return pairs


class Session:
    """A performer's skeleton, a character's, and the targets between them: what "retarget create" and "retarget edit"
    work on. Made by create and load."""

    __slots__ = ("_session",)

    def __init__(self, session):
        self._session = session

    def edit(self, name, value=None):
        """One edit, by the name of its option: edit("position", "Hips:Hips"), edit("prune-joints"). edit_kinds tells
        them all."""
        self.edits([(name, value)])

    def edits(self, edits):
        """Edits in order: names, or (name, value). Those before one that fails stay done."""
        self._session.edit(_edits(edits))

    @property
    def target(self):
        """The retarget subject as it stands, a copy as SkeletonFile; set it to go on with a changed one."""
        return SkeletonFile._of(self._session.target())

    @target.setter
    def target(self, file):
        self._session.replace(_parts(file))

    @property
    def source(self):
        """The performer's skeleton, a copy as SkeletonFile; None without one."""
        parts = self._session.source()
        return None if parts is None else SkeletonFile._of(parts)

    def targets(self):
        """A dict for each target, as "retarget targets --json" prints them; with a source its residuals in mm and
        degrees."""
        return self._session.targets()

    def propose(self):
        """Which segment of the source belongs to which of the retarget subject, a dict as "retarget map --json" prints
        it: pairs with scores and reasons, alternatives, what is left over. The edit "auto" takes the pairs over."""
        return self._session.propose()

    def align(self, chains=(), lock=()):
        """Brings the bind pose to the source's, as the edit "align" does: only some of "arms", "legs", "spine" and
        "others" where chains are given, and never the segments in lock; both count for this call alone. Returns the
        angles before and after."""
        self._session.align(_edits([*(("chain", chain) for chain in _list(chains)),
                                    *(("lock", segment) for segment in _list(lock)), "align"]))
        return self.report["aligned"]

    def solve(self, take, first=None, last=None, joints=(), rest_frame=None, output=None, fbx=None):
        """The character follows a Take in the frames from first to last, a Solved. The source moves by it, or without
        one a performer that is made of the take; joints and rest_frame as Take.poses has them. The character's motion
        goes to output, a path that ends in .bvh, or with the character's FBX file in .glb or .fbx."""
        return Solved(*self._session.solve(_wanted(take, Take), _frame(first), _frame(last), list(joints),
                                           _frame(rest_frame), _optional_path(output), _optional_path(fbx)))

    def check(self):
        """A list of Finding about the retarget subject."""
        return self.target.check()

    @property
    def report(self):
        """What edits have told, a dict: pairs that were proposed, angles of an alignment."""
        return self._session.report()

    def save(self, path):
        """Saves the retarget subject, the same bytes that the command line writes. The file that stands there is
        replaced when the whole of the new one stands on disk."""
        self._session.save(_path(path))


def read(path):
    """Reads a skeleton file (.qrt, .qrk, .qrs, .qrr) or legacy text (.qrx)."""
    return SkeletonFile._of(_core.read(_path(path)))


def compare(before, after):
    """In what two files differ, a list of Change; empty if in nothing."""
    return [Change(*parts) for parts in _core.compare(_parts(before), _parts(after))]


def bones(path):
    """The bones of an FBX file, a list of Bone, parents first."""
    return [Bone(*parts) for parts in _core.bones(_path(path))]


def create(fbx, source=None, root=None, scale_root_height=False, edits=()):
    """A Session with a retarget subject made from a character's FBX file, as "retarget create" makes it.

    root is a bone by name or "#" and its index; None takes the document's choice, and with the edits "auto" or "preset"
    the one that the body hangs on.
    """
    return Session(_core.make(_path(fbx), None, _optional_path(source), root, scale_root_height, _edits(edits)))


def load(subject, source=None, scale_root_height=False, edits=()):
    """A Session with a retarget subject from its file, as "retarget edit" loads it."""
    return Session(_core.make(None, _path(subject), _optional_path(source), None, scale_root_height, _edits(edits)))


def edit_kinds():
    """All edits: a list of (name, whether it takes a value, what it does)."""
    return _core.edit_kinds()


__all__ = ["Error", "Finding", "Change", "Bone", "SkeletonFile", "Kinematics", "Take", "Solved", "Session", "NO_PARENT", "NOT_SET", "read",
           "compare", "bones", "create", "load", "edit_kinds", *_classes]
