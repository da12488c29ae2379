"""The Python package beside the command line and beside numbers by hand."""
import copy
import logging
import math
import os
import pickle
import pathlib
import re
import subprocess
import sys
import threading

import numpy as np
import pytest

import retarget_setup as rs

HERE = pathlib.Path(__file__).resolve().parent
ROOT = HERE.parents[1]
FBX = ROOT / "demo/character.fbx"
SOURCE = ROOT / "demo/performer.qrs"
TAKE = ROOT / "demo/walk.bvh"
EDITS = ["match-file-pose", "auto", ("weight", "0=0.25"), "prune-joints", "update-targets"]


def retarget(*words):
    command = [os.environ["RETARGET"], "-q", *map(str, words)]
    return subprocess.run(command, check=True, capture_output=True, text=True).stdout


@pytest.fixture(scope="module")
def saved(tmp_path_factory):
    path = tmp_path_factory.mktemp("saved") / "kestrel.qrr"
    rs.create(FBX, source=SOURCE, edits=EDITS).save(path)
    return path


def test_session_saves_what_the_command_line_saves(saved, tmp_path):
    words = [word for edit in EDITS for word in ([f"--{edit}"] if isinstance(edit, str) else [f"--{edit[0]}", edit[1]])]
    retarget("create", "--fbx", FBX, "--source", SOURCE, *words, "-o", tmp_path / "kestrel.qrr")
    assert saved.read_bytes() == (tmp_path / "kestrel.qrr").read_bytes()


@pytest.mark.parametrize("path", sorted((ROOT / "tests/data/qrt").glob("*.qrs")), ids=lambda path: path.name)
def test_every_field_goes_through_python(path, tmp_path):
    # A copy of what another process would be handed, under a name that is no text.
    handed = pickle.loads(pickle.dumps(rs.read(path)))
    copy.deepcopy(handed).write(tmp_path / "ours\udcff.qrs")
    retarget("convert", path, tmp_path / "theirs.qrs")
    assert (tmp_path / "ours\udcff.qrs").read_bytes() == (tmp_path / "theirs.qrs").read_bytes()


def test_bones_of_a_file(saved):
    bones = rs.bones(FBX)
    skull = next(bone for bone in bones if bone.name == "skull")
    parents = {segment.name: segment.parent_segment_index for segment in rs.read(saved).subject.segments}
    assert set(parents) <= {bone.name for bone in bones} and skull.matrix.shape == (4, 4)
    assert bones[skull.parent].name == rs.read(saved).subject.segments[parents["skull"]].name


def arm():
    """A root of any pose, and an elbow 100 mm along its x, which is a hinge about z."""
    free = rs.Joint(joint_type=rs.JointType.FREE, bind_pose=[0.0] * 6)
    elbow = rs.Joint(joint_type="Ball", bind_pose=[0.0, 0.0, 0.5])
    subject = rs.Subject(name="arm", segments=[
        rs.Segment(name="upper", joint=free),
        rs.Segment(name="lower", segment_index=1, parent_segment_index=0, tree_depth=1, joint=elbow,
                   pre_translation=["100", "0", "0"])])
    return rs.SkeletonFile(subject, rs.ApplicationData(segments=[rs.SegmentDrawing(), rs.SegmentDrawing()]))


def test_poses_of_many_frames():
    kinematics = rs.Kinematics(arm())
    states = np.zeros((3, 9))
    states[1, 3:6] = 10, 20, 30
    states[2, 2] = math.pi / 2
    states[2, 8] = math.pi / 2
    poses = kinematics.poses(states)
    assert poses.shape == (3, 2, 4, 4)
    assert poses[:, 1, :3, 3] == pytest.approx(np.array([[100, 0, 0], [110, 20, 30], [0, 100, 0]]), abs=1e-12)
    half_turn = np.diag([-1.0, -1.0, 1.0])
    assert poses[2, 1, :3, :3] == pytest.approx(half_turn, abs=1e-12)
    assert kinematics.poses(states[2]) == pytest.approx(poses[2])
    assert kinematics.bind_pose() == pytest.approx([0, 0, 0, 0, 0, 0, 0, 0, 0.5])


def test_a_take_is_solved_as_on_the_command_line(saved, tmp_path):
    session, take = rs.load(saved, source=SOURCE), rs.Take(TAKE)
    solved = session.solve(take, first=10, last=19, output=tmp_path / "ours.glb", fbx=FBX)
    lines = retarget("solve", saved, "--take", TAKE, "--source", SOURCE, "--frames", "10:19", "--csv", "--fbx", FBX,
                     "-o", tmp_path / "theirs.glb").splitlines()[1:]
    assert (tmp_path / "ours.glb").read_bytes() == (tmp_path / "theirs.glb").read_bytes()
    told = np.array([[float(cell or "nan") for cell in line.split(",")[4:]] for line in lines])
    units = np.array([math.radians(1) if target["unit"] == "deg" else 1 for target in solved.report["targets"]])
    assert solved.residuals == pytest.approx(told * units, abs=1e-6, nan_ok=True) and solved.first == 10
    assert session.targets() == rs.load(saved, source=SOURCE).targets()
    # Rigid bones, each where the take's joint is, as far as the performer has the take's size.
    poses, joints = take.poses(session.source, 10, 19), take.joint_poses(10, 19)
    assert poses.shape == (10, len(session.source.subject.segments), 4, 4)
    pelvis = [name for name, parent in take.joints()].index("Pelvis")
    assert poses[:, 0, :3, 3] - poses[0, 0, :3, 3] == pytest.approx(
        solved.report["scale"] * (joints[:, pelvis, :3, 3] - joints[0, pelvis, :3, 3]), abs=0.5)
    assert [segment.name for segment in take.performer().subject.segments] == [name for name, _ in take.joints()]


def test_proposed_and_aligned(saved):
    session = rs.load(saved, source=SOURCE)
    assert {"source": "Cranium", "target": "skull"}.items() <= next(
        pair for pair in session.propose()["pairs"] if pair["source"] == "Cranium").items()

    def changed_by(**choice):
        before = session.target.subject
        told = session.align(**choice)
        assert told and session.report["aligned"] == told
        return {a.name for a, b in zip(before.segments, session.target.subject.segments)
                if a.joint.bind_pose != b.joint.bind_pose}
    assert changed_by(chains="arms", lock=["upperArmLeft"]) == {"foreArmLeft", "upperArmRight", "foreArmRight"}
    assert {"upperArmLeft", "thighLeft"} <= changed_by()


def broken(change):
    file = arm()
    change(file)
    return file


@pytest.mark.parametrize("kind, words, call", [
    (rs.Error, "could not be read as a skeleton file", lambda path: rs.read(path / "none.qrs")),
    (rs.Error, "File is not an FBX file", lambda path: rs.create(ROOT / "README.md")),
    (rs.Error, 'no source segment "Nobody"', lambda path: rs.create(FBX, SOURCE, edits=[("position", "Nobody:skull")])),
    (rs.Error, 'there is no edit "--fly"', lambda path: rs.create(FBX, edits=["fly"])),
    (rs.Error, "make no tree", lambda path: rs.Kinematics(rs.SkeletonFile())),
    (rs.Error, "could not be read as a take", lambda path: rs.Take(SOURCE)),
    (rs.Error, "Nobody", lambda path: rs.Take(TAKE).poses(rs.read(SOURCE), joints=[("Nobody", "Pelvis")])),
    (rs.Error, "has no targets", lambda path: rs.create(FBX, SOURCE).solve(rs.Take(TAKE))),
    (rs.Error, "the take has the frames 0 to", lambda path: rs.create(FBX, SOURCE, edits=["auto"]).solve(
        rs.Take(TAKE), first=9, last=3)),
    (ValueError, "the take has the frames 0 to", lambda path: rs.Take(TAKE).joint_poses(last=100000)),
    (ValueError, 'up is "y" or "z"', lambda path: rs.Take(TAKE, up="x")),
    (rs.Error, "none", lambda path: arm().write(path / "none" / "arm.qrs")),
    (ValueError, "states have a row of 9", lambda path: rs.Kinematics(arm()).poses([[1, 2, 3]])),
    (ValueError, "the versions are 1.0", lambda path: arm().write(path / "arm.qrs", version="9.9")),
    (ValueError, "subject has 2 segments, its application data 0", lambda path: rs.SkeletonFile(arm().subject).check()),
    (TypeError, r"segments\[1\].joint.mean\[1\] is no float",
     lambda path: broken(lambda file: setattr(file.subject.segments[1].joint, "mean", [1, "2"])).check()),
    (ValueError, r"segments\[0\].pre_rotation has 2 items, not 3",
     lambda path: broken(lambda file: setattr(file.subject.segments[0], "pre_rotation", ["0", "0"])).check()),
    (ValueError, r"segments\[0\].segment_index is not from 0",
     lambda path: broken(lambda file: setattr(file.subject.segments[0], "segment_index", -1)).check()),
    (ValueError, "joint_type is no JointType",
     lambda path: broken(lambda file: setattr(file.subject.segments[0].joint, "joint_type", "Rubber")).check()),
    (TypeError, "segments is a text", lambda path: broken(lambda file: setattr(file.subject, "segments", "")).check()),
    (TypeError, "a SkeletonFile is wanted here, not PosixPath", lambda path: rs.Kinematics(SOURCE)),
    (TypeError, "a Take is wanted here, not str", lambda path: rs.create(FBX).solve("walk.bvh")),
    (rs.Error, "that form holds the character, too", lambda path: rs.create(FBX, SOURCE, edits=["auto"]).solve(
        rs.Take(TAKE), last=3, output=path / "walk.glb")),
    (TypeError, "an edit is a name, or", lambda path: rs.create(FBX, edits=[("weight", 0, 2)])),
    (ValueError, "frames count from 0", lambda path: rs.Take(TAKE).joint_poses(-1)),
    (ValueError, "null character", lambda path: rs.read("a\0.qrs")),
    (AttributeError, "bindpose", lambda path: setattr(arm().subject.segments[0].joint, "bindpose", [])),
])
def test_what_cannot_be_done_says_why_and_writes_nothing(kind, words, call, tmp_path):
    with pytest.raises(kind, match=words):
        call(tmp_path)
    assert list(tmp_path.iterdir()) == []


def test_findings_and_messages(caplog):
    file = arm()
    before = file.check()
    file.subject.segments[1].parent_segment_index = 7
    assert {finding.name for finding in file.check() if finding not in before} == {"lower"}
    with caplog.at_level(logging.WARNING, "retarget_setup"):
        rs.create(FBX)
    assert any(record.name == "retarget_setup.retarget" and "--match-file-pose" in record.message
               for record in caplog.records)


def test_a_changed_subject_goes_back_into_the_session(saved):
    session = rs.load(saved, source=SOURCE)
    file = session.target
    file.subject.targets[0].weight = np.float32(0.75)
    session.target = file
    assert session.targets()[0]["weight"] == 0.75
    assert [change.id for change in rs.compare(rs.read(saved), session.target)] == ["weight"]
    assert session.source.subject.segments[0].name == rs.read(SOURCE).subject.segments[0].name


def test_threads_share_a_session(saved):
    session = rs.load(saved)
    counts = []

    def work():
        for _ in range(10):
            session.edit("weight", "0=0.5")
            counts.append(len(session.target.subject.targets))

    threads = [threading.Thread(target=work) for _ in range(4)]
    for thread in threads:
        thread.start()
    for thread in threads:
        thread.join()
    assert counts == [len(session.targets())] * 40


def test_types_are_those_of_the_package_and_take_the_documents_example(tmp_path):
    example = tmp_path / "example.py"
    example.write_text(document_code(), encoding="utf8")
    for command in (["mypy.stubtest", "--concise", "--allowlist", HERE / "types.allowed", "retarget_setup"],
                    ["mypy", "--strict", f"--cache-dir={tmp_path}", example]):
        done = subprocess.run([sys.executable, "-m", *map(str, command)], capture_output=True, text=True, cwd=tmp_path,
                              env=os.environ | {"MYPYPATH": str(pathlib.Path(rs.__file__).parents[1])})
        assert done.returncode == 0, done.stdout + done.stderr


def document_code():
    text = (ROOT / "docs/python.md").read_text(encoding="utf8")
    return "\n".join(re.findall(r"```python\n(.*?)```", text, re.S))


def test_the_documents_example(tmp_path, monkeypatch):
    for file in (FBX, SOURCE, TAKE):
        (tmp_path / file.name).symlink_to(file)
    monkeypatch.chdir(tmp_path)
    scope = {}
    exec(compile(document_code(), "docs/python.md", "exec"), scope)  # noqa: S102
    assert (tmp_path / "kestrel.qrr").exists() and scope["worst"] < 1
