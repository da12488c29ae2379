// A mesh of an FBX scene.
uniform mat4 u_ViewProjection;
uniform vec3 u_CameraPosition;
uniform mat4 u_ModelTransform;

attribute vec3 a_position;
attribute vec3 a_normal;
attribute vec2 a_uv;

varying vec4 v_Colour;
varying vec3 v_Normal;
varying vec3 v_Eye;
varying vec2 v_UV;

void main()
{
	vec4 position = u_ModelTransform * vec4(a_position, 1.0);
	v_Colour = vec4(1.0);
	v_Normal = ToWorld(u_ModelTransform, a_normal);
	v_Eye = FromCamera(position.xyz, u_CameraPosition);
	v_UV = a_uv;
	gl_Position = u_ViewProjection * position;
}
