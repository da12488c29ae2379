// A force plate, and the arrow of the force from where it acts: the vertices of the arrow, of length 1 along Z, have a
// normal; those of the plate have none.
uniform mat4 u_ViewProjection;
uniform mat4 u_ModelTransform;
uniform vec4 u_ModelColour;
uniform vec3 u_Force;
uniform vec3 u_CentreOfPressure;

attribute vec3 a_position;
attribute vec3 a_normal;
attribute vec2 a_uv;

varying vec4 v_Colour;
varying vec3 v_Normal;
varying vec2 v_UV;

void main()
{
	bool bPlate = dot(a_normal, a_normal) == 0.0;
	vec3 side = normalize(cross(u_Force, abs(u_Force.x) < abs(u_Force.y) ? vec3(1.0, 0.0, 0.0) : vec3(0.0, 1.0, 0.0)));
	vec3 other = cross(normalize(u_Force), side);
	vec3 arrow = u_CentreOfPressure + side * a_position.x + other * a_position.y + u_Force * a_position.z;
	v_Colour = u_ModelColour;
	v_Normal = bPlate ? u_ModelTransform[2].xyz : side * a_normal.x + other * a_normal.y;
	v_UV = a_uv;
	gl_Position = u_ViewProjection * (u_ModelTransform * vec4(bPlate ? a_position : arrow, 1.0));
}
