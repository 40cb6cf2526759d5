#!/usr/bin/env python3
"""Writes the stock profiles but the two that are kept by hand. Run by hand, beside the profiles; what it writes
is committed. A new convention is one row of CONVENTIONS."""
from pathlib import Path

# A row of a profile turns the source bone's frame into the target's. A bone with one child joint has its frame
# along the child, so that a limb in a T-pose needs nothing; a joint with several children has the axes of the
# space it stands in. What is no T-pose along the axes has codes here, by target bone.
NEUTRAL = "0,0,0,1,2,3"
FEET = {"LFoot": "0,0,0,3,2,-1", "RFoot": "0,0,0,3,2,-1"}  # toes in front of the ankle and below it

POSES = {
    "straight": FEET,
    # A spine that leans back and a neck that leans forward turn their frames by a quarter, whatever the angle.
    "curved": FEET | {"Waist": "0,0,0,3,2,-1", "Neck": "0,0,0,-3,2,1"},
    # So does a head whose end leans back over it.
    "curved, head back": FEET | {"Waist": "0,0,0,3,2,-1", "Neck": "0,0,0,-3,2,1", "Head": "0,0,0,3,2,-1"},
    # A spine that leans forward turns the other way.
    "leaning": FEET | {"Waist": "0,0,0,-3,2,1", "Neck": "0,0,0,-3,2,1"},
    "leaning, head back": FEET | {"Waist": "0,0,0,-3,2,1", "Neck": "0,0,0,-3,2,1", "Head": "0,0,0,3,2,-1"},
    # A middle foot behind the ankle.
    "curved, heels": {"Waist": "0,0,0,3,2,-1", "Neck": "0,0,0,-3,2,1", "LFoot": "0,0,0,-3,2,1",
                      "RFoot": "0,0,0,-3,2,1"},
    # A straight spine under a neck that leans forward.
    "bowed head": FEET | {"Neck": "0,0,0,-3,2,1", "Head": "0,0,0,-3,2,1"},
    # All bones along X in frames of their own: the right ones point back along it, or have their sides turned.
    "back along x": {
        "LowerTorso": "0,0,0,-2,1,3", "Waist": "0,0,0,3,2,-1", "UpperTorso": "0,0,0,3,1,2",
        "Neck": "0,0,0,3,2,-1", "Head": "0,0,0,3,2,-1", "RCollar": "0,0,0,-1,2,-3", "RUpperArm": "0,0,0,-1,2,-3",
        "RForearm": "0,0,0,-1,2,-3", "RHand": "0,0,0,-1,2,-3", "RFoot": "0,0,0,-1,2,-3"},
    "along x": {
        "LowerTorso": "0,0,0,3,1,2", "Waist": "0,0,0,3,2,-1", "UpperTorso": "0,0,0,3,1,2",
        "Neck": "0,0,0,3,2,-1", "Head": "0,0,0,3,2,-1", "RCollar": "0,0,0,-1,2,-3", "RUpperArm": "0,0,0,-1,2,-3",
        "RForearm": "0,0,0,-1,2,-3", "RHand": "0,0,0,-1,2,-3"},
    "limbs along x": {
        "UpperTorso": "0,0,0,-2,1,3", "Head": "0,0,0,2,-1,3", "LUpperArm": "0,0,0,3,2,-1",
        "LForearm": "0,0,0,3,2,-1", "LHand": "0,0,0,3,1,2", "RCollar": "0,0,0,-1,2,-3",
        "RUpperArm": "0,0,0,-1,2,-3", "RForearm": "0,0,0,-1,2,-3", "RHand": "0,0,0,2,1,-3",
        "LFoot": "0,0,0,3,1,2", "RFoot": "0,0,0,2,1,-3"},
}
# A hand with several fingers has the axes of the space and not those of the arm.
FINGERS = {"LHand": "0,0,-90,1,2,3", "RHand": "0,0,90,1,2,3"}

LIMBS = ("Collar", "UpperArm", "Forearm", "Hand", "Thigh", "Calf", "Foot")
LEFT_RIGHT, L_R, l_r = ("Left", "Right"), ("L", "R"), ("l", "r")

# By target limb; % is the side, and - a joint that the convention does not have.
HUMAN_IK = "%Shoulder %Arm %ForeArm %Hand %UpLeg %Leg %Foot"
BIOVISION = "%Collar %Shoulder %Elbow %Wrist %Hip %Knee %Ankle"
POSER = "%Collar %Shldr %ForeArm %Hand %Thigh %Shin %Foot"
BIPED = "%_Clavicle %_UpperArm %_Forearm %_Hand %_Thigh %_Calf %_Foot"
KINECT = "- Shoulder% Elbow% Wrist% Hip% Knee% Ankle%"

HUMAN_IK_POSES = {1: 2, 2: 3, 3: 3, 4: 3}  # how many of them, by the number of spine joints

SPINE = ["Spine"] + [f"Spine{i}" for i in range(1, 10)]
CHEST = ["Chest"] + [f"Chest{i}" for i in range(2, 5)]

PLAIN, BOTH, WITH = (False,), (False, True), (True,)  # without fingers, either way, with them

# File, name, prefix, hip, spine upward, neck (or -), head, sides, limbs, poses, fingers. The name is what an
# animator reads; {n} is the number of the spine's joints.
CONVENTIONS = [
    *[(f"HumanIK{n:02}", "MotionBuilder / HumanIK ({n})", "", "Hips", SPINE[:n], "Neck", "Head", LEFT_RIGHT,
       HUMAN_IK, ("straight", "curved", "leaning")[:HUMAN_IK_POSES.get(n, 1)], BOTH if n <= 6 else PLAIN)
      for n in range(1, 11)],
    *[(f"HumanIK{n:02}HeadBack", "MotionBuilder / HumanIK ({n}, curved, head back)", "", "Hips", SPINE[:n], "Neck",
       "Head", LEFT_RIGHT, HUMAN_IK, ("curved, head back",), WITH) for n in (3, 4)],
    *[(f"HumanIK{n:02}NoNeck", "MotionBuilder / HumanIK without neck ({n})", "", "Hips", SPINE[:n], "-", "Head",
       LEFT_RIGHT, HUMAN_IK, ("straight",), PLAIN) for n in (1, 2)],
    ("HumanIK02Neck1", "MotionBuilder / HumanIK, 21 joints ({n})", "", "Hips", SPINE[:2], "Neck1", "Head",
     LEFT_RIGHT, HUMAN_IK, ("straight",), PLAIN),
    ("LaFAN1", "LaFAN1 ({n})", "", "Hips", SPINE[:3], "Neck", "Head", LEFT_RIGHT, HUMAN_IK, ("along x",), PLAIN),
    ("RokokoHumanIK", "Rokoko Studio, HumanIK ({n})", "", "Hips", SPINE[:3], "Neck", "Head", LEFT_RIGHT, HUMAN_IK,
     ("limbs along x",), PLAIN),
    ("RokokoNewton", "Rokoko Studio, Newton ({n})", "", "Hips", SPINE[1:5], "Neck", "Head", LEFT_RIGHT,
     "%Shoulder %Arm %ForeArm %Hand %Thigh %Shin %Foot", ("straight",), WITH),
    ("Mixamo", "Mixamo ({n})", "mixamorig:", "Hips", SPINE[:3], "Neck", "Head", LEFT_RIGHT, HUMAN_IK, ("curved",),
     BOTH),
    ("CMUOriginal", "CMU, original names ({n})", "", "root", ["lowerback", "upperback", "thorax"], "lowerneck",
     "head", l_r, "%clavicle %humerus %radius %wrist %femur %tibia %foot", ("straight",), WITH),
    ("CMU", "CMU, MotionBuilder names ({n})", "", "Hips", ["LowerBack", "Spine", "Spine1"], "Neck", "Head",
     LEFT_RIGHT, HUMAN_IK, ("leaning, head back",), WITH),
    ("CMUMax", "CMU, 3ds Max names ({n})", "", "Hips", ["lowerback", "Chest", "Chest2"], "lowerneck", "Head",
     LEFT_RIGHT, BIOVISION, ("straight",), WITH),
    ("MaxLong2", "3ds Max / Biovision ({n})", "", "Hips", CHEST[:2], "Neck", "Head", LEFT_RIGHT, BIOVISION,
     ("curved",), PLAIN),
    ("Xsens", "Xsens MVN / 100STYLE ({n})", "", "Hips", CHEST[:4], "Neck", "Head", LEFT_RIGHT, BIOVISION,
     ("bowed head",), PLAIN),
    ("MaxUpLeg", "3ds Max, second names ({n})", "", "Hips", CHEST[:1], "Neck", "Head", LEFT_RIGHT,
     "%Collar %UpArm %LowArm %Hand %UpLeg %LowLeg %Foot", ("straight",), PLAIN),
    ("PoserLong", "Poser / DAZ figures ({n})", "", "hip", ["abdomen", "chest"], "neck", "head", l_r, POSER,
     ("straight",), WITH),
    ("DazGenesis2", "DAZ Genesis 1 and 2 ({n})", "", "hip", ["abdomen", "abdomen2", "chest"], "neck", "head", l_r,
     POSER, ("curved",), WITH),
    ("DazGenesis8", "DAZ Genesis 3 and 8 ({n})", "", "hip",
     ["abdomenLower", "abdomenUpper", "chestLower", "chestUpper"], "neckLower", "head", l_r,
     "%Collar %ShldrBend %ForearmBend %Hand %ThighBend %Shin %Foot", ("curved, heels",), WITH),
    ("DazGenesis9", "DAZ Genesis 9 ({n})", "", "hip", ["spine1", "spine2", "spine3", "spine4"], "neck1", "head",
     l_r, "%_shoulder %_upperarm %_forearm %_hand %_thigh %_shin %_foot", ("curved",), WITH),
    *[(f"Biped{n}", "3ds Max Biped ({n})", "Bip01_", "Pelvis", SPINE[:n], "Neck", "Head", L_R, BIPED, ("curved",),
       WITH) for n in (3, 4)],
    *[(f"Biped{n}NoBlanks", "3ds Max Biped without blanks ({n})", "Bip01", "Pelvis", SPINE[:n], "Neck", "Head",
       L_R, BIPED.replace("_", ""), ("curved",), WITH) for n in (3, 4)],
    ("XsensMVN", "Xsens MVN segments ({n})", "", "Pelvis", ["L5", "L3", "T12", "T8"], "Neck", "Head", LEFT_RIGHT,
     "%Shoulder %UpperArm %ForeArm %Hand %UpperLeg %LowerLeg %Foot", ("straight",), PLAIN),
    ("IPi", "iPi Mocap Studio ({n})", "", "Hip", ["LowerSpine", "MiddleSpine", "Chest"], "Neck", "Head", L_R,
     "%Clavicle %Shoulder %Forearm %Hand %Thigh %Shin %Foot", ("straight",), WITH),
    ("OptiTrack", "OptiTrack Motive ({n})", "", "Hip", ["Ab", "Chest"], "Neck", "Head", L_R,
     "%Shoulder %UArm %FArm %Hand %Thigh %Shin %Foot", ("straight",), BOTH),
    ("Kinect1", "Kinect 1 ({n})", "", "HipCenter", ["Spine", "ShoulderCenter"], "-", "Head", LEFT_RIGHT, KINECT,
     ("straight",), PLAIN),
    ("Kinect2", "Kinect 2 ({n})", "", "SpineBase", ["SpineMid", "SpineShoulder"], "Neck", "Head", LEFT_RIGHT,
     KINECT, ("straight",), WITH),
    ("KinectAzure", "Azure Kinect ({n})", "", "PELVIS", ["SPINE_NAVEL", "SPINE_CHEST"], "NECK", "HEAD",
     ("LEFT", "RIGHT"), "CLAVICLE_% SHOULDER_% ELBOW_% WRIST_% HIP_% KNEE_% ANKLE_%", ("straight",), WITH),
    ("SMPL", "SMPL / AMASS ({n})", "", "Pelvis", SPINE[1:4], "Neck", "Head", L_R,
     "%_Collar %_Shoulder %_Elbow %_Wrist %_Hip %_Knee %_Ankle", ("curved",), PLAIN),
    ("SMPLX", "SMPL-X ({n})", "", "pelvis", ["spine1", "spine2", "spine3"], "neck", "head", ("left", "right"),
     "%_collar %_shoulder %_elbow %_wrist %_hip %_knee %_ankle", ("curved",), WITH),
    ("Human36M", "Human3.6M ({n})", "", "Hip", ["Spine", "Thorax"], "Neck", "HeadEndSite", LEFT_RIGHT,
     "- %Shoulder %Elbow %Wrist %Hip %Knee %Ankle", ("straight",), PLAIN),
    ("Human36MNoHead", "Human3.6M without head ({n})", "", "Hip", ["Spine", "Thorax"], "Neck", "-", LEFT_RIGHT,
     "- %Shoulder %Elbow %Wrist %Hip %Knee %Ankle", ("straight",), PLAIN),
    ("SecondLife", "Second Life rig ({n})", "m", "Pelvis", ["Torso", "Chest"], "Neck", "Head", LEFT_RIGHT,
     "Collar% Shoulder% Elbow% Wrist% Hip% Knee% Ankle%", ("curved",), BOTH),
    ("BandaiNamco", "Bandai Namco ({n})", "", "Hips", ["Spine", "Chest"], "Neck", "Head", L_R,
     "Shoulder_% UpperArm_% LowerArm_% Hand_% UpperLeg_% LowerLeg_% Foot_%", ("back along x",), PLAIN),
    *[(f"Unreal{n}", "Unreal mannequin ({n})", "", "pelvis", [f"spine_{i:02}" for i in range(1, n + 1)], "neck_01",
       "head", l_r, "clavicle_% upperarm_% lowerarm_% hand_% thigh_% calf_% foot_%", ("straight",), WITH)
      for n in (3, 5)],
    *[(f"Unity{n}", "Unity humanoid / VRM ({n})", "", "Hips", ["Spine", "Chest", "UpperChest"][:n], "Neck", "Head",
       LEFT_RIGHT, "%Shoulder %UpperArm %LowerArm %Hand %UpperLeg %LowerLeg %Foot", ("straight",), BOTH)
      for n in (2, 3)],
    ("VRoid", "VRoid ({n})", "J_Bip_", "C_Hips", ["C_Spine", "C_Chest", "C_UpperChest"], "C_Neck", "C_Head", L_R,
     "%_Shoulder %_UpperArm %_LowerArm %_Hand %_UpperLeg %_LowerLeg %_Foot", ("straight",), WITH),
    ("Rigify", "Blender Rigify ({n})", "", "spine", ["spine.001", "spine.002", "spine.003"], "spine.004",
     "spine.006", L_R, "shoulder.% upper_arm.% forearm.% hand.% thigh.% shin.% foot.%", ("curved",), BOTH),
    ("Endorphin", "Endorphin ({n})", "", "root", ["LowerSpineJoint", "MiddleSpineJoint", "UpperSpineJoint"],
     "LowerNeckJoint", "UpperNeckJoint", LEFT_RIGHT,
     "%ClavicleJoint %ShoulderJoint %ElbowJoint %WristJoint %HipJoint %KneeJoint %AnkleJoint", ("straight",), PLAIN),
    ("Mega", "Mega ({n})", "", "Hips", ["UpperBack", "Chest"], "Neck", "Neck1", LEFT_RIGHT,
     "$Collar %UpArm %LowArm %Hand %UpLeg %LowLeg %Foot", ("straight",), PLAIN),
]


def mappings(prefix, hip, spine, neck, head, sides, limbs):
    """Source and target of every row, the target's pelvis bones with none."""
    middle = [(spine[(len(spine) - 1) // 2], "Waist")] if len(spine) > 1 else []
    rows = [(hip, "LowerTorso"), *middle, (spine[-1], "UpperTorso"), (neck, "Neck"), (head, "Head")]
    arms_and_legs = []
    for letter, side in zip(L_R, sides):
        limb = [(name.replace("%", side).replace("$", letter), letter + bone)
                for name, bone in zip(limbs.split(), LIMBS)]
        arms_and_legs.append((limb[:4], [(None, letter + "Pelvis")] + limb[4:]))
    (left_arm, left_leg), (right_arm, right_leg) = arms_and_legs
    return [(source and prefix + source, target)
            for source, target in rows + left_arm + right_arm + left_leg + right_leg if source != "-"]


def write(file, name, rows, codes):
    lines = [name, "FrameRate 30", "Position 0 0 0"]
    for source, target in rows:
        lines.append(f"{source} <---> {target} {codes.get(target, NEUTRAL)}" if source else f"* {target} . .1,2,3")
    Path(__file__).with_name(file + ".prf").write_text("\n".join(lines) + "\n")


def main():
    for file, name, prefix, hip, spine, neck, head, sides, limbs, poses, fingers in CONVENTIONS:
        rows = mappings(prefix, hip, spine, neck, head, sides, limbs)
        for pose in poses:
            for with_fingers in fingers:
                # What only some profiles of the convention have is told of them.
                words = [pose] * (pose != poses[0]) + ["fingers"] * with_fingers
                joints = f"{len(spine)} spine joint{'s' if len(spine) > 1 else ''}"
                write(file + "".join(word.capitalize() for word in words),
                      name.format(n=", ".join([joints] + words)), rows,
                      POSES[pose] | (FINGERS if with_fingers else {}))


if __name__ == "__main__":
    main()
