// A model of one colour.
uniform mat4 u_ViewProjection;
uniform mat4 u_ModelTransform;
uniform vec4 u_ModelColour;

attribute vec3 a_position;
attribute vec3 a_normal;

varying vec4 v_Colour;
varying vec3 v_Normal;

void main()
{
	v_Colour = u_ModelColour;
	v_Normal = ToWorld(u_ModelTransform, a_normal);
	gl_Position = u_ViewProjection * (u_ModelTransform * vec4(a_position, 1.0));
}
